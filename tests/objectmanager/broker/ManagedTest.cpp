#include "objectmanager/broker/Managed.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

#include <thread>

namespace om {
namespace {

// What is freed too late, twice or not at all, these tests show under the address and leak sanitizers.
class Ownership : public BrokerFixture {};

TEST_F(Ownership, ReleasedObjectsOfTheCallAreInvalidAfterwards) {
    CMPIString* made = string("text");
    EXPECT_EQ(made->ft->release(made).rc, CMPI_RC_OK);
    EXPECT_EQ(made->ft->release(made).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(made->ft->getCharPtr(made, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(Ownership, FreeingByTheMemoryTableIsTheSame) {
    CMPIString* made = string("text");
    broker->mft->freeString(broker, made);
    EXPECT_EQ(made->ft->getCharPtr(made, nullptr), nullptr);
}

TEST_F(Ownership, ArgumentsOfTheBrokerSurviveARelease) {
    auto& lent = adopted(std::make_unique<ContextObject>(owner, usualEntries("root/test")), Owner::Broker);
    CMPIContext* handle = &lent;
    EXPECT_EQ(handle->ft->release(handle).rc, CMPI_RC_OK);
    EXPECT_EQ(handle->ft->getEntryCount(handle, &rc), 6U);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(Ownership, ClonesSurviveTheCall) {
    CMPIInstance* copy = nullptr;
    {
        const Call inner;
        CMPIInstance* made = instance("C");
        made->ft->setProperty(made, "P", chars("v"), CMPI_chars);
        copy = made->ft->clone(made, &rc);
    }
    EXPECT_EQ(textOf(copy->ft->getProperty(copy, "P", &rc).value.string), "v");
    EXPECT_EQ(copy->ft->release(copy).rc, CMPI_RC_OK);
}

TEST_F(Ownership, WhatIsGotFromACloneLivesAsLongAsIt) {
    CMPIObjectPath* copy = nullptr;
    const CMPIString* name = nullptr;
    {
        const Call inner;
        CMPIObjectPath* made = path("VESKA_ComputerSystem");
        copy = made->ft->clone(made, &rc);
        name = copy->ft->getClassName(copy, &rc);
    }
    EXPECT_EQ(textOf(name), "VESKA_ComputerSystem");
    EXPECT_EQ(copy->ft->getClassName(copy, &rc), name) << "a clone that is asked often must not grow";
    copy->ft->release(copy);
    EXPECT_EQ(textOf(name), "VESKA_ComputerSystem") << "valid to the end of the call";
}

TEST_F(Ownership, APartOfACloneCannotBeReleasedAlone) {
    CMPIObjectPath* made = path("C");
    CMPIObjectPath* copy = made->ft->clone(made, &rc);
    CMPIString* name = copy->ft->getClassName(copy, &rc);
    EXPECT_EQ(name->ft->release(name).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(name), "C");
    copy->ft->release(copy);
}

TEST_F(Ownership, ChangingACloneLeavesWhatWasGotBefore) {
    CMPIObjectPath* made = path("Before");
    CMPIObjectPath* copy = made->ft->clone(made, &rc);
    const CMPIString* before = copy->ft->getClassName(copy, &rc);
    copy->ft->setClassName(copy, "After");
    EXPECT_EQ(textOf(copy->ft->getClassName(copy, &rc)), "After");
    EXPECT_EQ(textOf(before), "Before");
    copy->ft->release(copy);
}

TEST_F(Ownership, MarksNest) {
    auto* mft = broker->mft;
    CMPIString* outside = string("outside");
    const CMPIGcStat* outer = mft->mark(broker, &rc);
    ASSERT_NE(outer, nullptr);
    CMPIString* kept = string("kept");
    CMPIString* copy = kept->ft->clone(kept, nullptr);
    const CMPIGcStat* inner = mft->mark(broker, &rc);
    string("inner");
    EXPECT_EQ(mft->release(broker, inner).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(kept), "kept");
    EXPECT_EQ(mft->release(broker, inner).rc, CMPI_RC_ERR_INVALID_HANDLE);
    mft->mark(broker, &rc);
    EXPECT_EQ(mft->release(broker, outer).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(outside), "outside");
    EXPECT_EQ(textOf(copy), "kept");
    copy->ft->release(copy);
}

TEST_F(Ownership, OnAThreadWithoutACallTheBrokerKeepsTheObject) {
    CMPIString* made = nullptr;
    CMPIStatus released{};
    std::thread([&] {
        made = broker->eft->newString(broker, "elsewhere", nullptr);
        released = made->ft->release(made);
        CMPIStatus marked{};
        EXPECT_EQ(broker->mft->mark(broker, &marked), nullptr);
        EXPECT_EQ(marked.rc, CMPI_RC_ERR_FAILED);
    }).join();
    EXPECT_EQ(released.rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(made), "elsewhere");
}

TEST_F(Ownership, AnotherThreadsReleaseLeavesTheObjectToItsCall) {
    CMPIString* made = string("here");
    std::thread([made] { EXPECT_EQ(made->ft->release(made).rc, CMPI_RC_OK); }).join();
    EXPECT_EQ(textOf(made), "here");
}

TEST_F(Ownership, AttachedThreadsHaveTheirOwnCall) {
    CMPIContext* forThread = broker->bft->prepareAttachThread(broker, context());
    ASSERT_NE(forThread, nullptr);
    EXPECT_EQ(broker->bft->detachThread(broker, forThread).rc, CMPI_RC_ERR_FAILED);
    std::thread([this, forThread] {
        EXPECT_EQ(broker->bft->attachThread(broker, forThread).rc, CMPI_RC_OK);
        EXPECT_EQ(broker->bft->attachThread(broker, forThread).rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(textOf(broker->eft->newString(broker, "attached", nullptr)), "attached");
        EXPECT_EQ(forThread->ft->getEntryCount(forThread, nullptr), 6U);
        EXPECT_EQ(forThread->ft->release(forThread).rc, CMPI_RC_OK);
        EXPECT_EQ(broker->bft->detachThread(broker, forThread).rc, CMPI_RC_OK);
        EXPECT_EQ(broker->bft->detachThread(broker, forThread).rc, CMPI_RC_ERR_INVALID_HANDLE);
    }).join();
}

TEST_F(Ownership, AThreadThatIsNeverDetachedLeaksNothing) {
    CMPIContext* attached = broker->bft->prepareAttachThread(broker, context());
    EXPECT_NE(broker->bft->prepareAttachThread(broker, context()), nullptr); // and one that is never used
    std::thread([this, attached] {
        broker->bft->attachThread(broker, attached);
        broker->eft->newString(broker, "left behind in an attached thread, too long to be kept inside", nullptr);
    }).join();
    EXPECT_EQ(broker->bft->attachThread(broker, context()).rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(Ownership, ClonesMayBeUsedByManyThreads) {
    CMPIInstance* made = instance("VESKA_ComputerSystem");
    made->ft->setProperty(made, "Name", chars("node7"), CMPI_chars);
    CMPIInstance* copy = made->ft->clone(made, nullptr);
    std::vector<std::thread> threads;
    for (int t = 0; t < 4; ++t) {
        threads.emplace_back([copy] {
            for (int i = 0; i < 200; ++i) {
                EXPECT_EQ(textOf(copy->ft->getProperty(copy, "Name", nullptr).value.string), "node7");
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    copy->ft->release(copy);
}

} // namespace
} // namespace om
