#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

/// A broker's function tables made by hand, so that a test can let any slot fail, answer null, or be missing.
class FakeBroker {
public:
    FakeBroker();
    FakeBroker(const FakeBroker&) = delete;
    FakeBroker& operator=(const FakeBroker&) = delete;

    /// A named value of a path, an instance or an argument list; `elements` of an array, `text` of texts and dates.
    struct Entry {
        std::string name;
        CMPIData data;
    };
    struct Text {
        CMPIString cmpi;
        FakeBroker* fake;
        std::string text;
    };
    struct Array {
        CMPIArray cmpi;
        FakeBroker* fake;
        CMPIType type;
        std::vector<CMPIData> elements;
    };
    struct DateTime {
        CMPIDateTime cmpi;
        std::string text;
    };
    struct Path {
        CMPIObjectPath cmpi;
        FakeBroker* fake;
        std::string nameSpace, className;
        std::vector<Entry> entries;
    };
    struct Instance {
        CMPIInstance cmpi;
        FakeBroker* fake;
        std::vector<Entry> entries;
    };
    struct Args {
        CMPIArgs cmpi;
        FakeBroker* fake;
        std::vector<Entry> entries;
    };

    const CMPIBroker* get() const { return &broker; }

    CMPIObjectPath* makePath(const std::string& nameSpace, const std::string& className);
    CMPIInstance* makeInstance();
    CMPIArgs* makeArgs();
    CMPIString* makeString(const std::string& text);

    /// What an object holds as text: `Name=type:value`, separated by blanks.
    static std::string contents(const CMPIObjectPath* path);
    static std::string contents(const CMPIInstance* instance);

    /// How a slot's call goes: what it answers instead of success, if anything.
    bool refuses(const char* slot, CMPIStatus* status);
    /// Finds by name without regard to case, unless `namesByCase`; a null with 12 otherwise.
    CMPIData find(const std::vector<Entry>& entries, const char* name, CMPIStatus* status);
    CMPIData at(const std::vector<Entry>& entries, CMPICount index, CMPIString** name, CMPIStatus* status);
    CMPIStatus put(std::vector<Entry>& entries, const char* name, const CMPIValue* value, CMPIType type);
    CMPIArray* makeArray(CMPICount size, CMPIType type);
    CMPIDateTime* makeDateTime(const std::string& text);

    std::map<std::string, CMPIrc> refusals;  ///< by slot
    std::set<std::string> nullAnswers;       ///< slots that answer null and OK
    std::map<std::string, std::string> base; ///< class → superclass, of the schema
    bool namesByCase = false;
    bool writesStatus = true; ///< on success; some brokers do not everywhere
    int classQuestions = 0;   ///< calls of classPathIsA

    CMPIBrokerEncFT encapsulated{};
    CMPIStringFT stringTable{};
    CMPIArrayFT arrayTable{};
    CMPIObjectPathFT pathTable{};
    CMPIInstanceFT instanceTable{};
    CMPIArgsFT argsTable{};
    CMPIDateTimeFT dateTimeTable{};
    CMPIBroker broker{};

private:
    std::vector<std::unique_ptr<Text>> strings;
    std::vector<std::unique_ptr<Array>> arrays;
    std::vector<std::unique_ptr<DateTime>> dateTimes;
    std::vector<std::unique_ptr<Path>> paths;
    std::vector<std::unique_ptr<Instance>> instances;
    std::vector<std::unique_ptr<Args>> argumentLists;
};
