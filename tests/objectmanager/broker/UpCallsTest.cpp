#include "objectmanager/broker/ObjectManager.h"
#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

/// Calls the broker of a loaded provider as that provider would.
class UpCalls : public testing::Test {
protected:
    ObjectManager manager{TEST_PROVIDER, "Test", "root/test"};
    Call call;
    const CMPIBroker* broker = manager.broker();
    const CMPIBrokerFT* bft = broker->bft;
    Broker& owner = open(broker);
    CMPIContext* context = &make<ContextObject>(owner, usualEntries("root/test"));
    CMPIStatus rc{CMPI_RC_ERR_FAILED, nullptr};

    CMPIObjectPath* path(const char* className, const char* name = nullptr) {
        CMPIObjectPath* made = broker->eft->newObjectPath(broker, "root/test", className, nullptr);
        if (name != nullptr) made->ft->addKey(made, "Name", chars(name), CMPI_chars);
        return made;
    }
    std::string text(CMPIInstance* instance, const char* name) {
        return textOf(instance->ft->getProperty(instance, name, nullptr).value.string);
    }
    std::string first(CMPIEnumeration* instances, const char* name) {
        return text(instances->ft->getNext(instances, nullptr).value.inst, name);
    }
    std::string firstKey(CMPIEnumeration* paths) {
        CMPIObjectPath* one = paths->ft->getNext(paths, nullptr).value.ref;
        return textOf(one->ft->getKey(one, "Name", nullptr).value.string);
    }
};

TEST_F(UpCalls, Enumerations) {
    CMPIEnumeration* names = bft->enumerateInstanceNames(broker, context, path("Test_Thing"), &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(firstKey(names), "a");
    EXPECT_EQ(first(bft->enumerateInstances(broker, context, path("Test_Thing"), nullptr, &rc), "Name"), "a");
    EXPECT_EQ(first(bft->execQuery(broker, context, path("Test_Thing"), "q", "WQL", &rc), "Language"), "WQL");
    EXPECT_EQ(bft->execQuery(broker, context, path("Test_Thing"), nullptr, "WQL", &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(UpCalls, TheProvidersErrorIsTheStatus) {
    EXPECT_EQ(bft->enumerateInstanceNames(broker, context, path("Test_Denied"), &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(bft->deleteInstance(broker, context, path("Test_Thing")).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(UpCalls, GetInstanceFindsExactlyOne) {
    const char* list[] = {"One", nullptr};
    CMPIInstance* one = bft->getInstance(broker, context, path("Test_Thing", "x"), list, &rc);
    EXPECT_EQ(text(one, "One"), "asked for");
    EXPECT_EQ(bft->getInstance(broker, context, path("Test_Thing"), nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(bft->getInstance(broker, context, path("Test_Twice", "x"), nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(UpCalls, FlagsOfTheContextReachTheProvider) {
    const CMPIUint32 flags = CMPI_FLAG_LocalOnly;
    context->ft->addEntry(context, CMPIInvocationFlags, at(flags), CMPI_uint32);
    CMPIInstance* one = bft->getInstance(broker, context, path("Test_Thing", "x"), nullptr, &rc);
    EXPECT_EQ(one->ft->getProperty(one, "Flags", &rc).value.uint32, 1U);
}

TEST_F(UpCalls, CreateAndModify) {
    CMPIInstance* made = broker->eft->newInstance(broker, path("Test_Thing"), &rc);
    made->ft->setProperty(made, "Name", chars("new"), CMPI_chars);
    CMPIObjectPath* created = bft->createInstance(broker, context, path("Test_Thing"), made, &rc);
    EXPECT_EQ(textOf(created->ft->getKey(created, "Name", &rc).value.string), "new");
    const CMPIUint32 speed = 7;
    made->ft->setProperty(made, "Speed", at(speed), CMPI_uint32);
    const char* list[] = {"Speed", nullptr};
    EXPECT_EQ(bft->modifyInstance(broker, context, path("Test_Thing"), made, list).rc, CMPI_RC_OK);
    EXPECT_EQ(bft->modifyInstance(broker, context, path("Test_Thing"), made, nullptr).rc,
              CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(UpCalls, PropertiesGoThroughInstances) {
    const CMPIUint32 speed = 7;
    EXPECT_EQ(bft->setProperty(broker, context, path("Test_Thing"), "Speed", at(speed), CMPI_uint32).rc, CMPI_RC_OK);
    const CMPIData given = bft->getProperty(broker, context, path("Test_Thing", "x"), "Other", &rc);
    EXPECT_EQ(textOf(given.value.string), "asked for");
    bft->getProperty(broker, context, path("Test_Bare", "x"), "Other", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    bft->getProperty(broker, context, path("Test_Thing"), "Name", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
}

TEST_F(UpCalls, AssociationFiltersArriveEachInItsPlace) {
    CMPIObjectPath* one = path("Test_Thing");
    EXPECT_EQ(first(bft->associators(broker, context, one, "A", "B", "C", "D", nullptr, &rc), "ResultRole"), "D");
    EXPECT_EQ(first(bft->references(broker, context, one, "B", "C", nullptr, &rc), "Role"), "C");
    EXPECT_EQ(firstKey(bft->associatorNames(broker, context, one, nullptr, nullptr, nullptr, "D", &rc)), "D");
    EXPECT_EQ(firstKey(bft->referenceNames(broker, context, one, nullptr, "C", &rc)), "C");
}

TEST_F(UpCalls, InvokeFillsTheOutArguments) {
    CMPIArgs* in = broker->eft->newArgs(broker, nullptr);
    CMPIArgs* out = broker->eft->newArgs(broker, nullptr);
    in->ft->addArg(in, "Text", chars("there and back"), CMPI_chars);
    const CMPIData value = bft->invokeMethod(broker, context, path("Test_Thing"), "Echo", in, out, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(value.type, CMPI_uint32);
    EXPECT_EQ(value.value.uint32, 1U);
    EXPECT_EQ(textOf(out->ft->getArg(out, "Text", nullptr).value.string), "there and back");
    bft->invokeMethod(broker, context, path("Test_Thing"), "Unheard", in, out, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_METHOD_NOT_FOUND);
}

TEST_F(UpCalls, WhatTheProviderDoesNotOfferIsNotSupported) {
    const ObjectManager partial(TEST_PROVIDER, "Empty", "root/test");
    const CMPIBroker* other = partial.broker();
    EXPECT_EQ(other->bft->associators(other, context, path("C"), nullptr, nullptr, nullptr, nullptr, nullptr, &rc),
              nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    const Broker bare(Schema::builtin(), "root/test");
    EXPECT_EQ(bare.handle()->bft->deleteInstance(bare.handle(), context, path("C")).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

} // namespace
} // namespace om
