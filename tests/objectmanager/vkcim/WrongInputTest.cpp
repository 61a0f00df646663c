// What somebody at a terminal is told who gets something wrong, and the status that a script sees. The provider is our
// own, on the simulated host of the documents.
#include "tests/support/Process.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <sys/stat.h>

namespace {

using support::Outcome;
using testing::HasSubstr;

struct Wrong {
    int status;
    std::vector<std::string> words;
    std::string message; ///< the lines on standard error, or what is in them where it begins with `…`
};

const std::string tryHelp = "Try 'vkcim --help'.\n";

const Wrong table[] = {
    // Commands and options
    {2, {}, "vkcim: a command is missing\n" + tryHelp},
    {2, {"reprot"}, "vkcim: there is no command 'reprot'; did you mean report?\n" + tryHelp},
    {2, {"--formt", "json", "report"}, "vkcim: there is no option '--formt'; did you mean --format?\n" + tryHelp},
    {2, {"--format", "yaml", "report"}, "…yaml"},
    {2, {"report", "VESKA_TimeService"}, "…VESKA_TimeService"},
    {2, {"names"}, "…CLASS is required"},
    {2, {"names", ""}, "vkcim: names: what it works on is empty\n" + tryHelp},
    {2, {"help", "nmaes"}, "vkcim: help: there is no command 'nmaes'; did you mean names?\n" + tryHelp},
    {2, {"modify", "VESKA_TimeService"}, "…NAME=VALUE is required"},
    {2, {"invoke", "VESKA_TimeService"}, "…METHOD is required"},
    {2, {"value", "VESKA_TimeService"}, "…PROPERTY is required"},
    {2, {"--repeat", "0", "names", "VESKA_TimeService"}, "…--repeat"},
    {2, {"--threads", "4", "report"}, "vkcim: report: --threads does not go with it\n" + tryHelp},
    {2,
     {"create", "VESKA_TimeService", "A=1", "--dry-run"},
     "vkcim: create: --dry-run does not go with it\n" + tryHelp},
    {2, {"names", "VESKA_TimeService", "--verbose"}, "vkcim: names: --verbose does not go with it\n" + tryHelp},
    {2, {"--format", "json", "classes"}, "vkcim: classes: its output is text alone\n" + tryHelp},
    {2, {"--namespace", "root cimv2", "report"}, "vkcim: --namespace: a namespace cannot hold byte 0x20\n" + tryHelp},
    {2, {"--properties", "A,,B", "names", "VESKA_TimeService"}, "…a name in \"A,,B\" is empty"},
    {2, {"--fault", "bogus:1", "names", "VESKA_TimeService"}, "…no broker operation is called 'bogus'"},
    {2, {"--url", "", "report"}, "vkcim: --url: is empty\n" + tryHelp},
    {2, {"--url=", "report"}, "vkcim: --url: is empty\n" + tryHelp},
    {3, {"--library", "/nowhere/lib.so", "report"}, "…/nowhere/lib.so"},
    {3, {"--provider", "Other", "names", "VESKA_TimeService"}, "…Other_Create_InstanceMI"},
    // Classes
    {1,
     {"names", "VESKA_TimeSevice"},
     "vkcim: CMPI_RC_ERR_INVALID_CLASS (5)\n"
     "vkcim: there is no class VESKA_TimeSevice; did you mean VESKA_TimeService?\n"},
    {1,
     {"instances", "TimeService"},
     "vkcim: CMPI_RC_ERR_INVALID_CLASS (5)\n"
     "vkcim: there is no class TimeService; did you mean VESKA_TimeService?\n"},
    {1,
     {"names", "Something_Else"},
     "vkcim: CMPI_RC_ERR_INVALID_CLASS (5)\nvkcim: there is no class Something_Else in the schema\n"},
    {1,
     {"names", "CIM_ComputerSystem"},
     "vkcim: CMPI_RC_ERR_INVALID_CLASS (5)\n"
     "vkcim: ask for a class below CIM_ComputerSystem: VESKA_ComputerSystem\n"},
    {1,
     {"associators", "VESKA_ComputerSystem", "--assoc-class", "VESKA_ComputerCapabilites"},
     "vkcim: CMPI_RC_ERR_INVALID_CLASS (5)\n"
     "vkcim: there is no class VESKA_ComputerCapabilites; did you mean VESKA_ComputerCapabilities?\n"},
    {2,
     {"describe", "VESKA_TimeSevice"},
     "vkcim: there is no class VESKA_TimeSevice; did you mean VESKA_TimeService?\n"},
    {2,
     {"describe", "VESKA_TimeService.Name=\"a\""},
     "vkcim: VESKA_TimeService.Name=\"a\": a class name has no keys\n"},
    {2, {"names", "VESKA_TimeService.Name=\"a\""}, "vkcim: VESKA_TimeService.Name=\"a\": a class name has no keys\n"},
    {2, {"names", "7Class"}, "vkcim: path 7Class: position 1: a class name cannot start with '7'\n"},
    // Paths
    {2, {"get", "VESKA_ComputerSystem.Name"}, "…position 26: '=' is missing after key Name\n"},
    {2, {"get", "VESKA_ComputerSystem.Name=\"a"}, "…position 27: the quote is not closed\n"},
    {2, {"get", "VESKA_ComputerSystem.Name=a"}, "…position 27: the value of key Name is no quoted text, integer, TRUE"},
    {2, {"get", "VESKA_ComputerSystem.Name=\"a\",name=\"b\""}, "…position 31: key name is given twice\n"},
    {2,
     {"get", "VESKA_ComputerSystem.Name=\"\\a\""},
     "…position 29: 'a' after '\\' (only \\\" and \\\\ are escapes)\n"},
    {2, {"get", "//host/root/cimv2:VESKA_ComputerSystem"}, "…a path here names no host\n"},
    {2, {"get", "-"}, "vkcim: standard input holds no path\n"},
    {4,
     {"get", "VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"node8\""},
     "vkcim: no such instance: VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"node8\"\n"},
    // The provider ignores a key that it does not know, or has with another type.
    {0,
     {"get", "VESKA_PhysicalPackage.Tag=7"},
     "vkcim: path VESKA_PhysicalPackage.Tag=7: position 27: key Tag of VESKA_PhysicalPackage is text in quotes\n"},
    {0,
     {"get", "VESKA_PhysicalPackage.Tg=\"CZ1234\""},
     "…position 23: VESKA_PhysicalPackage has no key Tg; did you mean Tag?\n"},
    // Values
    {4,
     {"value", "VESKA_PhysicalPackage", "SeralNumber"},
     "vkcim: VESKA_PhysicalPackage has no property SeralNumber; did you mean SerialNumber?\n"
     "vkcim: SeralNumber of VESKA_PhysicalPackage has no value\n"},
    {4, {"value", "VESKA_TimeService", "Region"}, "vkcim: Region of VESKA_TimeService has no value\n"},
    {1, {"value", "VESKA_TimeSevice", "Name"}, "…did you mean VESKA_TimeService?\n"},
    {2, {"modify", "VESKA_TimeService", "AutomaticDSTAdjustment"}, "…position 23: '=' is missing (NAME=VALUE)\n"},
    {2,
     {"modify", "VESKA_TimeService", "AutomaticDSTAdjustment=maybe"},
     "vkcim: AutomaticDSTAdjustment=maybe: position 24: \"maybe\" is neither true nor false\n"},
    {4,
     {"modify", "VESKA_TimeService", "AutomaticDSTAdjustment="},
     "vkcim: AutomaticDSTAdjustment of VESKA_TimeService is boolean, not string\n"
     "vkcim: not changed: AutomaticDSTAdjustment is true\n"},
    {2, {"modify", "VESKA_TimeService", "A=1", "a=2"}, "vkcim: a=2: position 1: a is given twice\n"},
    {2,
     {"invoke", "VESKA_CIMServiceConfig", "SetCIMconfig", "deliveryRetryAttempts=-1"},
     "…position 23: -1 is out of range"},
    {2, {"modify", "VESKA_TimeService", "A=uint8:256"}, "…256 is out of range for uint8 (0 to 255)\n"},
    {2, {"invoke", "VESKA_TimeService", "ManageTime", "TimeData=now"}, "…\"now\" is no datetime"},
    // Changes that do not happen
    {4,
     {"modify", "VESKA_TimeService", "Region=Berlin"},
     "vkcim: Region of VESKA_TimeService is not writable\nvkcim: not changed: Region has no value\n"},
    {4,
     {"modify", "VESKA_TimeService", "AutomaticDSTAjustment=true"},
     "vkcim: VESKA_TimeService has no property AutomaticDSTAjustment; did you mean AutomaticDSTAdjustment?\n"
     "vkcim: not changed: AutomaticDSTAjustment has no value\n"},
    {1, {"modify", "VESKA_ComputerSystem", "Name=node8"}, "…Name of VESKA_ComputerSystem is not writable\n"},
    {1, {"delete", "VESKA_ComputerSystem"}, "vkcim: CMPI_RC_ERR_NOT_SUPPORTED (7)\n"},
    {1, {"query", "SELECT"}, "vkcim: CMPI_RC_ERR_NOT_SUPPORTED (7)\n"},
    // Methods
    {1,
     {"invoke", "VESKA_TimeService", "SetClock"},
     "…vkcim: VESKA_TimeService has no method SetClock; its methods: ManageTime\n"},
    {1,
     {"invoke", "VESKA_TimeService", "StopService"},
     "…VESKA_TimeService inherits StopService; its own methods: ManageTime\n"},
    {1, {"invoke", "VESKA_ComputerSystem", "Reboot"}, "…VESKA_ComputerSystem has no method Reboot; it has none\n"},
    {1,
     {"invoke", "VESKA_TimeService", "ManageTime"},
     "…vkcim: ManageTime takes GetRequest (boolean, in), TimeData (datetime, in and out), "
     "ManagedElement (ref to CIM_ManagedElement, in)\nvkcim: not given: GetRequest, TimeData, ManagedElement\n"},
    {1,
     {"invoke", "VESKA_TimeService", "ManageTime", "GetReqest=true", "ManagedElement=VESKA_ComputerSystem"},
     "…ManageTime has no parameter GetReqest; did you mean GetRequest?\n"},
    {1,
     {"invoke", "VESKA_TimeService", "ManageTime", "GetRequest=uint8:1", "ManagedElement=VESKA_ComputerSystem"},
     "…vkcim: GetRequest of ManageTime is boolean, not uint8\n"},
};

Outcome vkcim(std::vector<std::string> words, const std::string& tree, const char* variable = "VK_INSTRUMENTATION_TREE",
              const std::string& input = "") {
    words.insert(words.begin(), VKCIM);
    if (geteuid() == 0) { // without the rights by which root may read everything
        const std::vector<std::string> asUser = {"/usr/bin/setpriv", "--bounding-set=-dac_override,-dac_read_search",
                                                 "--inh-caps=-dac_override,-dac_read_search"};
        words.insert(words.begin(), asUser.begin(), asUser.end());
    }
    return support::runCommand(words, input, {{variable, tree}, {"NVLOG_SINK", "file:/dev/null"}});
}

TEST(WrongInput, IsAnsweredWithAMessageAndAStatus) {
    for (const Wrong& wrong : table) {
        SCOPED_TRACE(testing::PrintToString(wrong.words));
        const Outcome outcome = vkcim(wrong.words, VK_EXAMPLE_HOST);
        EXPECT_EQ(outcome.status, wrong.status);
        if (wrong.status > 1) {
            EXPECT_EQ(outcome.output, "");
        }
        const std::string part = "…";
        if (wrong.message.substr(0, part.size()) == part)
            EXPECT_THAT(outcome.error, HasSubstr(wrong.message.substr(part.size())));
        else
            EXPECT_EQ(outcome.error, wrong.message);
    }
}

TEST(WrongInput, OfMegabytesIsCutInMessages) {
    const Outcome outcome = vkcim({"names", "-"}, VK_EXAMPLE_HOST);
    EXPECT_EQ(outcome.status, 2) << "a class is no path";
    const Outcome unknown =
        vkcim({"get", "-"}, VK_EXAMPLE_HOST, "VK_INSTRUMENTATION_TREE", std::string(5000000, 'x') + '\n');
    EXPECT_EQ(unknown.status, 1);
    EXPECT_LT(unknown.error.size(), 1000U);
    EXPECT_THAT(unknown.error, HasSubstr("x in the schema\n"));
    const Outcome unreadable =
        vkcim({"get", "-"}, VK_EXAMPLE_HOST, "VK_INSTRUMENTATION_TREE", std::string(5000000, 'x') + ".K\n");
    EXPECT_EQ(unreadable.status, 2);
    EXPECT_LT(unreadable.error.size(), 1000U);
    EXPECT_THAT(unreadable.error, HasSubstr(": position 5000003: '=' is missing after key K\n"));
}

/// Every command that asks the provider.
const std::vector<std::vector<std::string>> askingCommands = {{"report"},
                                                              {"names", "VESKA_ComputerSystem"},
                                                              {"instances", "VESKA_PhysicalPackage"},
                                                              {"get", "VESKA_TimeService"},
                                                              {"value", "VESKA_TimeService", "Name"},
                                                              {"modify", "VESKA_TimeService", "Region=x"},
                                                              {"associators", "VESKA_ComputerSystem"}};

void expectUnreadable(const char* variable, const std::string& place, const std::string& problem) {
    for (const std::vector<std::string>& words : askingCommands) {
        SCOPED_TRACE(testing::PrintToString(words) + " of " + place);
        const Outcome outcome = vkcim(words, place, variable);
        EXPECT_EQ(outcome.status, 4);
        EXPECT_THAT(outcome.error, HasSubstr("vkcim: the host cannot be read: " + place + ": " + problem));
    }
}

TEST(WrongInput, AHostThatCannotBeReadIsSaidByEveryCommand) {
    const support::TemporaryDirectory directory;
    directory.write("broken.json", "{\"nodes\": [");
    expectUnreadable("VK_INSTRUMENTATION_TREE", directory.path("missing.json"), "No such file or directory\n");
    expectUnreadable("VK_INSTRUMENTATION_TREE", directory.path("broken.json"), "");
    expectUnreadable("VK_INSTRUMENTATION_TREE", directory.path(), "not a regular file\n");
    expectUnreadable("VK_INSTRUMENTATION_ROOT", directory.path("missing"), "No such file or directory\n");
    expectUnreadable("VK_INSTRUMENTATION_ROOT", directory.path("broken.json"), "Not a directory\n");
    const Outcome once = vkcim({"names", "VESKA_ComputerSystem"}, "/nowhere");
    EXPECT_EQ(once.error, "vkcim: the host cannot be read: /nowhere: No such file or directory\n") << "one line";
    EXPECT_EQ(vkcim({"classes"}, "/nowhere").status, 0) << "it asks no host";
    const Outcome dry = vkcim({"--dry-run", "modify", "VESKA_TimeService", "AutomaticDSTAdjustment=false"}, "/nowhere");
    EXPECT_EQ(dry.status, 4);
    EXPECT_EQ(dry.error, once.error);
    EXPECT_THAT(dry.output, HasSubstr("host      the simulated host in /nowhere\n"));
}

TEST(WrongInput, OfWhatMayNotBeReadIsSaidToo) {
    const support::TemporaryDirectory directory;
    directory.write("secret/tree.json", "{}");
    chmod(directory.path("secret").c_str(), 0);
    expectUnreadable("VK_INSTRUMENTATION_TREE", directory.path("secret/tree.json"), "Permission denied\n");
    expectUnreadable("VK_INSTRUMENTATION_ROOT", directory.path("secret"), "Permission denied\n");
    chmod(directory.path("secret").c_str(), 0700);
}

TEST(WrongInput, AChangeThatTheHostRefusesHasItsReason) {
    const support::TemporaryDirectory directory;
    directory.write("tree.json", R"({"nodes":[{"type":40,"path":"/c","properties":{"200":1},"failWrites":[200]}]})");
    const Outcome refused =
        vkcim({"modify", "VESKA_TimeService", "AutomaticDSTAdjustment=false"}, directory.path("tree.json"));
    EXPECT_EQ(refused.status, 4);
    EXPECT_EQ(refused.error, "vkcim: not changed: AutomaticDSTAdjustment is true (" + directory.path("tree.json") +
                                 ": property 200 of \"/c\" not written: its writing fails)\n");
    const Outcome other = vkcim({"modify", "VESKA_TimeService", "AutomaticDSTAdjustment=false", "Region=Berlin"},
                                directory.path("tree.json"));
    EXPECT_THAT(other.error, HasSubstr("vkcim: not changed: Region has no value\n")) << "the reason is another one's";
    const Outcome unasked = vkcim({"--dry-run", "modify", "VESKA_TimeService", "AutomaticDSTAdjustment=false"},
                                  directory.path("tree.json"));
    EXPECT_EQ(unasked.status, 0);
    EXPECT_THAT(unasked.output, HasSubstr("host      the simulated host in " + directory.path("tree.json") + "\n"));
    EXPECT_THAT(unasked.output, HasSubstr("  AutomaticDSTAdjustment=boolean:false\nNothing was asked.\n"));
}

} // namespace
