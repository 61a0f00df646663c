#include "tests/objectmanager/broker/BrokerFixture.h"

#include "objectmanager/broker/Enumeration.h"
#include "objectmanager/broker/Error.h"

#include <vector>

namespace om {
namespace {

/// Calls every slot with a null object, one whose handle is null, and one of another kind; then with a good object and
/// nulls for all other arguments, which must not crash, and answer a code for every slot with a status.
template <class Handle, class... Slots>
void misuse(Handle* good, Slots... slots) {
    Handle nullHandle = *good;
    nullHandle.hdl = nullptr;
    Handle foreign = *good;
    foreign.ft = nullptr;
    for (Handle* bad : {static_cast<Handle*>(nullptr), &nullHandle, &foreign}) {
        for (const CMPIrc code : {codeWithNulls(slots, bad)...}) EXPECT_EQ(code, CMPI_RC_ERR_INVALID_HANDLE);
    }
    for (const CMPIrc code : {codeWithNulls(slots, good)...}) EXPECT_NE(code, CMPI_RC_NEVER_UNLOAD);
}

class Misuse : public BrokerFixture {};

TEST_F(Misuse, OfStrings) {
    auto* ft = string("x")->ft;
    misuse(string("x"), ft->clone, ft->getCharPtr, ft->release);
}

TEST_F(Misuse, OfArrays) {
    auto* ft = array(1, CMPI_string)->ft;
    misuse(array(0, CMPI_string), ft->clone, ft->getSize, ft->getSimpleType, ft->getElementAt, ft->setElementAt,
           ft->release);
}

TEST_F(Misuse, OfDateTimes) {
    CMPIDateTime* now = broker->eft->newDateTime(broker, nullptr);
    misuse(now, now->ft->clone, now->ft->getBinaryFormat, now->ft->getStringFormat, now->ft->isInterval,
           now->ft->release);
}

TEST_F(Misuse, OfPaths) {
    CMPIObjectPath* one = path("C");
    auto* ft = one->ft;
    misuse(one, ft->clone, ft->setNameSpace, ft->getNameSpace, ft->setHostname, ft->getHostname, ft->setClassName,
           ft->getClassName, ft->addKey, ft->getKey, ft->getKeyAt, ft->getKeyCount, ft->setNameSpaceFromObjectPath,
           ft->setHostAndNameSpaceFromObjectPath, ft->getClassQualifier, ft->getPropertyQualifier,
           ft->getMethodQualifier, ft->getParameterQualifier, ft->toString, ft->release);
}

TEST_F(Misuse, OfInstances) {
    CMPIInstance* one = instance("C");
    auto* ft = one->ft;
    misuse(one, ft->clone, ft->getProperty, ft->getPropertyAt, ft->getPropertyCount, ft->setProperty, ft->getObjectPath,
           ft->setPropertyFilter, ft->setObjectPath, ft->setPropertyWithOrigin, ft->release);
}

TEST_F(Misuse, OfArguments) {
    CMPIArgs* one = args();
    auto* ft = one->ft;
    misuse(one, ft->clone, ft->addArg, ft->getArg, ft->getArgAt, ft->getArgCount, ft->release);
}

TEST_F(Misuse, OfContexts) {
    CMPIContext* one = context();
    auto* ft = one->ft;
    misuse(one, ft->clone, ft->getEntry, ft->getEntryAt, ft->getEntryCount, ft->addEntry, ft->release);
}

TEST_F(Misuse, OfEnumerations) {
    CMPIEnumeration* one = &make<EnumerationObject>(owner, static_cast<CMPIType>(CMPI_ref), std::vector<Value>());
    auto* ft = one->ft;
    misuse(one, ft->clone, ft->getNext, ft->hasNext, ft->toArray, ft->release);
}

TEST_F(Misuse, OfResults) {
    Answer answer;
    CMPIResult* one = &make<ResultObject>(owner, Operation::GetInstance, answer);
    auto* ft = one->ft;
    misuse(one, ft->clone, ft->returnData, ft->returnInstance, ft->returnObjectPath, ft->returnError, ft->returnDone,
           ft->release);
}

TEST_F(Misuse, OfErrors) {
    CMPIError* one = &make<ErrorObject>(owner, ErrorAttributes());
    auto* ft = one->ft;
    misuse(one, ft->clone, ft->getErrorType, ft->getOtherErrorType, ft->getOwningEntity, ft->getMessageID,
           ft->getMessage, ft->getPerceivedSeverity, ft->getProbableCause, ft->getProbableCauseDescription,
           ft->getRecommendedActions, ft->getErrorSource, ft->getErrorSourceFormat, ft->getOtherErrorSourceFormat,
           ft->getCIMStatusCode, ft->getCIMStatusCodeDescription, ft->getMessageArguments, ft->setErrorType,
           ft->setOtherErrorType, ft->setProbableCauseDescription, ft->setRecommendedActions, ft->setErrorSource,
           ft->setErrorSourceFormat, ft->setOtherErrorSourceFormat, ft->setCIMStatusCodeDescription,
           ft->setMessageArguments, ft->release);
}

/// Brokers: a null one, an empty one, and a good one with nulls for all else.
template <class... Slots>
void misuseBroker(const CMPIBroker* good, Slots... slots) {
    const CMPIBroker empty{};
    for (const CMPIBroker* bad : {static_cast<const CMPIBroker*>(nullptr), &empty}) {
        for (const CMPIrc code : {codeWithNulls(slots, bad)...}) EXPECT_EQ(code, CMPI_RC_ERR_INVALID_HANDLE);
    }
    for (const CMPIrc code : {codeWithNulls(slots, good)...}) EXPECT_NE(code, CMPI_RC_NEVER_UNLOAD);
}

TEST_F(Misuse, OfFactories) {
    auto* eft = broker->eft;
    misuseBroker(broker, eft->newInstance, eft->newObjectPath, eft->newArgs, eft->newString, eft->newArray,
                 eft->newDateTime, eft->newDateTimeFromBinary, eft->newDateTimeFromChars, eft->newSelectExp,
                 eft->classPathIsA, eft->toString, eft->isOfType, eft->getType, eft->logMessage, eft->trace,
                 eft->newCMPIError, eft->openMessageFile, eft->closeMessageFile);
}

TEST_F(Misuse, OfMessages) {
    auto* eft = broker->eft;
    EXPECT_EQ(eft->getMessage(nullptr, "id", "text", &rc, 0), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(eft->getMessage2(broker, "id", nullptr, nullptr, &rc, 0), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

/// Up-calls open the path before all else.
template <class... Slots>
void misuseUpCalls(const CMPIBroker* good, Slots... slots) {
    for (const CMPIrc code : {codeWithNulls(slots, good)...}) EXPECT_EQ(code, CMPI_RC_ERR_INVALID_HANDLE);
    for (const CMPIrc code : {codeWithNulls(slots, nullptr)...}) EXPECT_EQ(code, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(Misuse, OfUpCalls) {
    auto* bft = broker->bft;
    misuseUpCalls(broker, bft->attachThread, bft->detachThread, bft->enumerateInstanceNames, bft->getInstance,
                  bft->createInstance, bft->modifyInstance, bft->deleteInstance, bft->execQuery,
                  bft->enumerateInstances, bft->associators, bft->associatorNames, bft->references, bft->referenceNames,
                  bft->invokeMethod, bft->setProperty, bft->getProperty);
    EXPECT_EQ(bft->prepareAttachThread(broker, nullptr), nullptr);
    EXPECT_EQ(bft->prepareAttachThread(nullptr, context()), nullptr);
    EXPECT_EQ(codeWithNulls(bft->deliverIndication, broker), CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(Misuse, OfMemory) {
    auto* mft = broker->mft;
    EXPECT_EQ(codeWithNulls(mft->mark, nullptr), CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(mft->release(broker, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(mft->release(broker, &owner).rc, CMPI_RC_ERR_INVALID_HANDLE);
    for (const CMPIBroker* each : {static_cast<const CMPIBroker*>(nullptr), broker}) {
        mft->freeInstance(each, nullptr);
        mft->freeObjectPath(each, nullptr);
        mft->freeArgs(each, nullptr);
        mft->freeString(each, nullptr);
        mft->freeArray(each, nullptr);
        mft->freeDateTime(each, nullptr);
        mft->freeSelectExp(each, nullptr);
        mft->cmpiFree(each, nullptr);
    }
    EXPECT_EQ(mft->cmpiMalloc(nullptr, 1), nullptr);
    EXPECT_EQ(mft->cmpiStrDup(broker, nullptr), nullptr);
}

TEST_F(Misuse, OfThreadFunctions) {
    auto* xft = broker->xft;
    EXPECT_EQ(xft->resolveFileName(nullptr), nullptr);
    EXPECT_EQ(xft->newThread(nullptr, nullptr, 0), nullptr);
    for (const int error :
         {xft->joinThread(nullptr, nullptr), xft->cancelThread(nullptr), xft->threadOnce(nullptr, nullptr),
          xft->createThreadKey(nullptr, nullptr), xft->condWait(nullptr, nullptr),
          xft->timedCondWait(nullptr, nullptr, nullptr), xft->signalCondition(nullptr), xft->destroyThreadKey(~0U),
          xft->setThreadSpecific(~0U, nullptr)}) {
        EXPECT_EQ(error, EINVAL);
    }
    EXPECT_EQ(xft->getThreadSpecific(~0U), nullptr);
    xft->destroyMutex(nullptr);
    xft->lockMutex(nullptr);
    xft->unlockMutex(nullptr);
    xft->destroyCondition(nullptr);
}

/// A table is nothing but pointers after its version.
template <class Table>
void expectFull(const Table* table) {
    const void* slots[sizeof(Table) / sizeof(void*)];
    std::memcpy(slots, table, sizeof slots);
    for (std::size_t i = 1; i < std::size(slots); ++i) EXPECT_NE(slots[i], nullptr) << "slot " << i;
}

TEST_F(Misuse, NoSlotIsNull) {
    expectFull(broker->bft);
    expectFull(broker->eft);
    expectFull(broker->xft);
    expectFull(broker->mft);
    expectFull(string("x")->ft);
    expectFull(array(0, CMPI_string)->ft);
    expectFull(path("C")->ft);
    expectFull(instance("C")->ft);
    expectFull(args()->ft);
    expectFull(broker->eft->newDateTime(broker, nullptr)->ft);
    expectFull(&ContextObject::table);
    expectFull(&EnumerationObject::table);
    expectFull(&ResultObject::table);
    expectFull(&ErrorObject::table);
    EXPECT_EQ(broker->bft->brokerVersion, 200U);
    EXPECT_EQ(broker->eft->ftVersion, 200);
    EXPECT_EQ(broker->mft->ftVersion, 200);
}

} // namespace
} // namespace om
