#include "platform/providerutilities/FakeBroker.h"

#include <strings.h>

namespace {

constexpr CMPIStatus ok{CMPI_RC_OK, nullptr};

CMPIData nothing() {
    CMPIData data{};
    data.state = CMPI_nullValue | CMPI_notFound;
    return data;
}

template <typename Object, typename Cmpi>
Object& of(const Cmpi* object) {
    return *static_cast<Object*>(object->hdl);
}

FakeBroker& of(const CMPIBroker* broker) {
    return *static_cast<FakeBroker*>(broker->hdl);
}

FakeBroker::Path& of(const CMPIObjectPath* path) {
    return of<FakeBroker::Path>(path);
}
FakeBroker::Instance& of(const CMPIInstance* instance) {
    return of<FakeBroker::Instance>(instance);
}
FakeBroker::Args& of(const CMPIArgs* args) {
    return of<FakeBroker::Args>(args);
}

/// The status of a slot that has none to write to.
CMPIStatus statusOf(FakeBroker& fake, const char* slot) {
    CMPIStatus status = ok;
    fake.refuses(slot, &status);
    return status;
}

std::string textOf(const CMPIData& data) {
    if ((data.state & CMPI_nullValue) != 0) return "null";
    switch (data.type) {
    case CMPI_string:
        return "string:" + of<FakeBroker::Text>(data.value.string).text;
    case CMPI_dateTime:
        return "datetime:" + of<FakeBroker::DateTime>(data.value.dateTime).text;
    case CMPI_ref:
        return "ref:" + of(data.value.ref).className;
    case CMPI_boolean:
        return data.value.boolean != 0 ? "boolean:true" : "boolean:false";
    case CMPI_uint16:
        return "uint16:" + std::to_string(data.value.uint16);
    case CMPI_uint32:
        return "uint32:" + std::to_string(data.value.uint32);
    case CMPI_real32:
        return "real32:" + std::to_string(data.value.real32);
    default:
        break;
    }
    if ((data.type & CMPI_ARRAY) == 0) return "type " + std::to_string(data.type);
    const auto& array = of<FakeBroker::Array>(data.value.array);
    std::string text = data.type == CMPI_stringA ? "strings[" : data.type == CMPI_uint16A ? "uint16s[" : "?[";
    for (const CMPIData& element : array.elements) text += textOf(element) + ",";
    return text + "]";
}

std::string textOf(const std::vector<FakeBroker::Entry>& entries) {
    std::string text;
    for (const auto& entry : entries) text += (text.empty() ? "" : " ") + entry.name + "=" + textOf(entry.data);
    return text;
}

bool isDateTime(const char* text) {
    return std::string(text).size() == 25;
}

void fillBrokerTable(CMPIBrokerEncFT& table) {
    table.newInstance = [](const CMPIBroker* broker, const CMPIObjectPath*, CMPIStatus* status) {
        return of(broker).refuses("newInstance", status) ? nullptr : of(broker).makeInstance();
    };
    table.newObjectPath = [](const CMPIBroker* broker, const char* ns, const char* cls, CMPIStatus* status) {
        return of(broker).refuses("newObjectPath", status) ? nullptr : of(broker).makePath(ns, cls);
    };
    table.newString = [](const CMPIBroker* broker, const char* text, CMPIStatus* status) {
        return of(broker).refuses("newString", status) ? nullptr : of(broker).makeString(text);
    };
    table.newArray = [](const CMPIBroker* broker, CMPICount size, CMPIType type, CMPIStatus* status) {
        return of(broker).refuses("newArray", status) ? nullptr : of(broker).makeArray(size, type);
    };
    table.newDateTimeFromChars = [](const CMPIBroker* broker, const char* text, CMPIStatus* status) -> CMPIDateTime* {
        if (of(broker).refuses("newDateTimeFromChars", status)) return nullptr;
        if (isDateTime(text)) return of(broker).makeDateTime(text);
        *status = {CMPI_RC_ERR_INVALID_PARAMETER, nullptr};
        return nullptr;
    };
    table.classPathIsA = [](const CMPIBroker* broker, const CMPIObjectPath* path, const char* cls,
                            CMPIStatus* status) -> CMPIBoolean {
        FakeBroker& fake = of(broker);
        ++fake.classQuestions;
        if (fake.refuses("classPathIsA", status)) return 1; // a lie that must not be believed
        auto found = fake.base.find(of(path).className);
        while (found != fake.base.end() && found->first != cls) found = fake.base.find(found->second);
        return found != fake.base.end() ? 1 : 0;
    };
}

void fillPathTable(CMPIObjectPathFT& table) {
    table.getNameSpace = [](const CMPIObjectPath* path, CMPIStatus* status) {
        FakeBroker& fake = *of(path).fake;
        return fake.refuses("getNameSpace", status) ? nullptr : fake.makeString(of(path).nameSpace);
    };
    table.getClassName = [](const CMPIObjectPath* path, CMPIStatus* status) {
        FakeBroker& fake = *of(path).fake;
        return fake.refuses("getClassName", status) ? nullptr : fake.makeString(of(path).className);
    };
    table.addKey = [](CMPIObjectPath* path, const char* name, const CMPIValue* value, CMPIType type) {
        const CMPIStatus status = statusOf(*of(path).fake, "addKey");
        return status.rc != CMPI_RC_OK ? status : of(path).fake->put(of(path).entries, name, value, type);
    };
    table.getKey = [](const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
        FakeBroker& fake = *of(path).fake;
        return fake.refuses("getKey", status) ? nothing() : fake.find(of(path).entries, name, status);
    };
    table.getKeyAt = [](const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* status) {
        FakeBroker& fake = *of(path).fake;
        return fake.refuses("getKeyAt", status) ? nothing() : fake.at(of(path).entries, index, name, status);
    };
    table.getKeyCount = [](const CMPIObjectPath* path, CMPIStatus* status) {
        const bool refused = of(path).fake->refuses("getKeyCount", status);
        return refused ? CMPICount{99} : static_cast<CMPICount>(of(path).entries.size());
    };
}

void fillInstanceTables(CMPIInstanceFT& instances, CMPIArgsFT& arguments) {
    instances.setProperty = [](const CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type) {
        const CMPIStatus status = statusOf(*of(instance).fake, "setProperty");
        return status.rc != CMPI_RC_OK ? status : of(instance).fake->put(of(instance).entries, name, value, type);
    };
    instances.getProperty = [](const CMPIInstance* instance, const char* name, CMPIStatus* status) {
        FakeBroker& fake = *of(instance).fake;
        CMPIStatus ignored = ok;
        const CMPIData data = fake.find(of(instance).entries, name, &ignored); // given along even with a failure
        if (!fake.refuses("getProperty", status) && ignored.rc != CMPI_RC_OK) *status = ignored;
        return data;
    };
    arguments.addArg = [](const CMPIArgs* args, const char* name, const CMPIValue* value, CMPIType type) {
        return of(args).fake->put(of(args).entries, name, value, type);
    };
    arguments.getArg = [](const CMPIArgs* args, const char* name, CMPIStatus* status) {
        FakeBroker& fake = *of(args).fake;
        return fake.refuses("getArg", status) ? nothing() : fake.find(of(args).entries, name, status);
    };
}

} // namespace

FakeBroker::FakeBroker() {
    fillBrokerTable(encapsulated);
    fillPathTable(pathTable);
    fillInstanceTables(instanceTable, argsTable);
    stringTable.getCharPtr = [](const CMPIString* string, CMPIStatus* status) {
        auto& text = of<Text>(string);
        return text.fake->refuses("getCharPtr", status) ? nullptr : text.text.c_str();
    };
    arrayTable.setElementAt = [](CMPIArray* cmpi, CMPICount index, const CMPIValue* value, CMPIType type) {
        auto& array = of<Array>(cmpi);
        const CMPIStatus status = statusOf(*array.fake, "setElementAt");
        if (status.rc != CMPI_RC_OK) return status;
        if (index >= array.elements.size()) return CMPIStatus{CMPI_RC_ERR_NO_SUCH_PROPERTY, nullptr};
        if (type != array.type) return CMPIStatus{CMPI_RC_ERR_TYPE_MISMATCH, nullptr};
        array.elements[index] = {type, CMPI_goodValue, *value};
        return ok;
    };
    broker.hdl = this;
    broker.eft = &encapsulated;
}

bool FakeBroker::refuses(const char* slot, CMPIStatus* status) {
    const auto refusal = refusals.find(slot);
    if (refusal != refusals.end())
        *status = {refusal->second, nullptr};
    else if (writesStatus)
        *status = ok;
    return refusal != refusals.end() || nullAnswers.count(slot) > 0;
}

CMPIData FakeBroker::find(const std::vector<Entry>& entries, const char* name, CMPIStatus* status) {
    for (const Entry& entry : entries) {
        if (namesByCase ? entry.name == name : strcasecmp(entry.name.c_str(), name) == 0) return entry.data;
    }
    *status = {CMPI_RC_ERR_NO_SUCH_PROPERTY, nullptr};
    return nothing();
}

CMPIData FakeBroker::at(const std::vector<Entry>& entries, CMPICount index, CMPIString** name, CMPIStatus* status) {
    if (index >= entries.size() || entries[index].name.empty()) {
        *status = {CMPI_RC_ERR_NO_SUCH_PROPERTY, nullptr};
        return nothing();
    }
    if (name != nullptr) *name = makeString(entries[index].name);
    return entries[index].data;
}

CMPIStatus FakeBroker::put(std::vector<Entry>& entries, const char* name, const CMPIValue* value, CMPIType type) {
    CMPIData data{type, CMPI_goodValue, {}};
    if (value == nullptr) {
        data.state = CMPI_nullValue;
    } else if (type == CMPI_chars) {
        data.type = CMPI_string;
        data.value.string = makeString(reinterpret_cast<const char*>(value));
    } else {
        data.value = *value;
    }
    entries.push_back({name, data});
    return ok;
}

CMPIObjectPath* FakeBroker::makePath(const std::string& nameSpace, const std::string& className) {
    paths.push_back(std::make_unique<Path>(Path{{nullptr, &pathTable}, this, nameSpace, className, {}}));
    paths.back()->cmpi.hdl = paths.back().get();
    return &paths.back()->cmpi;
}

CMPIInstance* FakeBroker::makeInstance() {
    instances.push_back(std::make_unique<Instance>(Instance{{nullptr, &instanceTable}, this, {}}));
    instances.back()->cmpi.hdl = instances.back().get();
    return &instances.back()->cmpi;
}

CMPIArgs* FakeBroker::makeArgs() {
    argumentLists.push_back(std::make_unique<Args>(Args{{nullptr, &argsTable}, this, {}}));
    argumentLists.back()->cmpi.hdl = argumentLists.back().get();
    return &argumentLists.back()->cmpi;
}

CMPIString* FakeBroker::makeString(const std::string& text) {
    strings.push_back(std::make_unique<Text>(Text{{nullptr, &stringTable}, this, text}));
    strings.back()->cmpi.hdl = strings.back().get();
    return &strings.back()->cmpi;
}

CMPIArray* FakeBroker::makeArray(CMPICount size, CMPIType type) {
    arrays.push_back(
        std::make_unique<Array>(Array{{nullptr, &arrayTable}, this, type, std::vector<CMPIData>(size, nothing())}));
    arrays.back()->cmpi.hdl = arrays.back().get();
    return &arrays.back()->cmpi;
}

CMPIDateTime* FakeBroker::makeDateTime(const std::string& text) {
    dateTimes.push_back(std::make_unique<DateTime>(DateTime{{nullptr, &dateTimeTable}, text}));
    dateTimes.back()->cmpi.hdl = dateTimes.back().get();
    return &dateTimes.back()->cmpi;
}

std::string FakeBroker::contents(const CMPIObjectPath* path) {
    return textOf(of(path).entries);
}
std::string FakeBroker::contents(const CMPIInstance* instance) {
    return textOf(of(instance).entries);
}
