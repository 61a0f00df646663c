#include "objectmanager/broker/Fault.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

#include <set>
#include <thread>

namespace om {
namespace {

using testing::Contains;
using testing::Each;
using testing::SizeIs;

class FaultTest : public BrokerFixture {};

TEST_F(FaultTest, KindsAreNamedAfterSlots) {
    EXPECT_THAT(faultNames(), Contains("newObjectPath"));
    EXPECT_THAT(std::set<std::string>(faultNames().begin(), faultNames().end()), SizeIs(faultNames().size()));
    EXPECT_EQ(faultKind("newInstance"), FaultKind::newInstance);
    EXPECT_EQ(faultKind("createThreadKey"), FaultKind::createThreadKey);
    EXPECT_EQ(faultKind(faultNames().back()), FaultKind::createThreadKey);
    EXPECT_EQ(faultKind("None"), std::nullopt);
    EXPECT_EQ(faultKind("newinstance"), std::nullopt);
}

TEST_F(FaultTest, OneCallFailsAndNoOtherOne) {
    CallWatch watch(Fault{FaultKind::newString, 2});
    EXPECT_EQ(textOf(string("one")), "one");
    EXPECT_FALSE(watch.happened());
    EXPECT_NE(path("A"), nullptr) << "another kind";
    EXPECT_EQ(string("two"), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_TRUE(watch.happened());
    EXPECT_EQ(textOf(string("three")), "three");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(FaultTest, ALastingOneGoesOn) {
    const CallWatch watch(Fault{FaultKind::newString, 2, true});
    EXPECT_NE(string("one"), nullptr);
    EXPECT_EQ(string("two"), nullptr);
    EXPECT_EQ(string("three"), nullptr);
}

TEST_F(FaultTest, AnUnstatedOneAnswersNullAndOK) {
    const CallWatch watch(Fault{FaultKind::newString, 1, false, true});
    EXPECT_EQ(string("one"), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(FaultTest, WhatFailsIsNotDone) {
    CMPIObjectPath* const made = path("A");
    const CallWatch watch(Fault{FaultKind::addKey, 1, false, true});
    EXPECT_EQ(made->ft->addKey(made, "Name", chars("x"), CMPI_chars).rc, CMPI_RC_ERR_FAILED)
        << "a status that is returned always tells";
    EXPECT_EQ(made->ft->getKeyCount(made, nullptr), 0u);
}

TEST_F(FaultTest, FailedDataIsNotThere) {
    CMPIObjectPath* const made = path("A");
    made->ft->addKey(made, "Name", chars("x"), CMPI_chars);
    const CallWatch watch(Fault{FaultKind::getKey, 1, true, true});
    const CMPIData data = made->ft->getKey(made, "Name", &rc);
    EXPECT_EQ(data.state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(FaultTest, SlotsOfOneNameCountTogether) {
    CMPIObjectPath* const made = path("A");
    const CMPIInstance* const one = instance("A");
    const CallWatch watch(Fault{FaultKind::clone, 2});
    CMPIObjectPath* const copy = made->ft->clone(made, &rc);
    ASSERT_NE(copy, nullptr);
    EXPECT_EQ(one->ft->clone(one, &rc), nullptr);
    copy->ft->release(copy);
}

TEST_F(FaultTest, ItEndsWithTheWatchAndStaysOnItsThread) {
    {
        const CallWatch watch(Fault{FaultKind::newString, 1, true});
        const CallWatch within(Fault{FaultKind::newArray, 1, true}); // of a call back: the outer one goes on
        EXPECT_EQ(string("one"), nullptr);
        EXPECT_NE(array(1, CMPI_uint16), nullptr);
        std::thread([this] { EXPECT_NE(broker->eft->newString(broker, "elsewhere", nullptr), nullptr); }).join();
    }
    EXPECT_NE(string("two"), nullptr);
    const CallWatch none{std::nullopt};
    EXPECT_EQ(CallWatch::current(), nullptr);
}

TEST_F(FaultTest, AnObserverIsToldOfEachCallBeforeItIsDone) {
    std::vector<std::string> calls;
    CMPIObjectPath* made = nullptr;
    const CallWatch watch(std::nullopt, [&](const std::string& slot) {
        calls.push_back(slot + (slot == "addKey" ? std::to_string(made->ft->getKeyCount(made, nullptr)) : ""));
    });
    made = path("A");
    made->ft->addKey(made, "Name", chars("x"), CMPI_chars);
    made->ft->addKey(made, nullptr, chars("x"), CMPI_chars); // refused, and seen all the same
    EXPECT_THAT(calls, testing::ElementsAre("newObjectPath", "getKeyCount", "addKey0", "getKeyCount", "addKey1"));
}

TEST_F(FaultTest, AnObserverIsToldOfACallThatFails) {
    std::vector<std::string> calls;
    const CallWatch watch(Fault{FaultKind::newString}, [&](const std::string& slot) { calls.push_back(slot); });
    EXPECT_EQ(string("one"), nullptr);
    EXPECT_NE(array(1, CMPI_uint16), nullptr);
    EXPECT_THAT(calls, testing::ElementsAre("newString", "newArray"));
}

/// Whether a fault of that kind hits what `use` calls.
template <class Use>
bool hits(const char* name, Use use) {
    CallWatch watch(Fault{*faultKind(name)});
    use();
    return watch.happened();
}

TEST_F(FaultTest, EverySlotAnswersToItsOwnName) {
    CMPIObjectPath* const one = path("A");
    CMPIInstance* const object = instance("A");
    CMPIArray* const list = array(1, CMPI_uint16);
    CMPIArgs* const arguments = args();
    CMPIDateTime* const time = dateTime("20240101120000.000000+000");
    CMPIContext* const entries = context();
    const CMPIUint16 number = 1;
    const std::vector<bool> hit = {
        hits("newInstance", [&] { instance("A"); }),
        hits("newObjectPath", [&] { path("A"); }),
        hits("newArgs", [&] { args(); }),
        hits("newArray", [&] { array(1, CMPI_uint16); }),
        hits("newDateTimeFromChars", [&] { dateTime("20240101120000.000000+000"); }),
        hits("classPathIsA", [&] { broker->eft->classPathIsA(broker, one, "A", &rc); }),
        hits("getMessage", [&] { broker->eft->getMessage(broker, "", "text", &rc, 0); }),
        hits("getClassName", [&] { one->ft->getClassName(one, &rc); }),
        hits("getNameSpace", [&] { one->ft->getNameSpace(one, &rc); }),
        hits("getKeyAt", [&] { one->ft->getKeyAt(one, 0, nullptr, &rc); }),
        hits("getKeyCount", [&] { one->ft->getKeyCount(one, &rc); }),
        hits("setProperty", [&] { object->ft->setProperty(object, "P", at(number), CMPI_uint16); }),
        hits("getProperty", [&] { object->ft->getProperty(object, "P", &rc); }),
        hits("setElementAt", [&] { list->ft->setElementAt(list, 0, at(number), CMPI_uint16); }),
        hits("getArg", [&] { arguments->ft->getArg(arguments, "P", &rc); }),
        hits("getArgCount", [&] { arguments->ft->getArgCount(arguments, &rc); }),
        hits("addArg", [&] { arguments->ft->addArg(arguments, "P", at(number), CMPI_uint16); }),
        hits("getBinaryFormat", [&] { time->ft->getBinaryFormat(time, &rc); }),
        hits("getStringFormat", [&] { time->ft->getStringFormat(time, &rc); }),
        hits("getEntry", [&] { entries->ft->getEntry(entries, "P", &rc); }),
        hits("cmpiMalloc", [&] { broker->mft->cmpiMalloc(broker, 1); }),
    };
    EXPECT_THAT(hit, Each(true));
}

} // namespace
} // namespace om
