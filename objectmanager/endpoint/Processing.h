#pragma once

#include "objectmanager/endpoint/Authentication.h"
#include "objectmanager/endpoint/Limits.h"
#include "objectmanager/endpoint/Workers.h"

#include <mutex>
#include <set>

namespace endpoint {

/// Whole requests on their way to an answer. Operations run in workers: one that hangs holds its worker, is named in
/// the log, and its client gets an error in time. Passwords are checked by threads of their own, which may be slow
/// without anybody else waiting.
class Processing {
public:
    Processing(Operations& operations, const Authentication& authentication, const Limits& limits);

    /// Suspends the connection, and resumes it when the work is finished: MHD asks again then.
    void begin(const WorkPointer& work);

    /// Answers for workers that take too long.
    void answerForHanging();

    /// Lets what is running end, and answers what is left. Whether no worker hangs.
    bool stop();

private:
    void hand(const WorkPointer& work, Workers& to, void (Processing::*job)(const WorkPointer&));
    void authenticate(const WorkPointer& work);
    void operate(const WorkPointer& work);
    void permit(Work& work, const HttpAnswer& asked, bool changes, Caller& caller) const;
    void done(const WorkPointer& work, HttpAnswer made);
    static void cameBack(const Work& work);
    void finish(const WorkPointer& work, HttpAnswer made);
    void resume(const WorkPointer& work);

    Operations& operations;
    const Authentication& authentication;
    const Limits limits;
    Workers workers;
    Workers checkers;
    mutable std::mutex mutex; // of what follows, and of what is handed on or answered
    std::set<WorkPointer> working;
};

} // namespace endpoint
