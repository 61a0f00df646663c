#include "objectmanager/endpoint/Processing.h"

#include "objectmanager/endpoint/Log.h"

#include <microhttpd.h>

namespace endpoint {
namespace {

constexpr std::size_t mostReplacements = 3; ///< for each thread

} // namespace

Processing::Processing(Operations& asked, const Authentication& by, const Limits& given)
    : operations(asked), authentication(by), limits(given),
      workers(given.workers, given.queue, given.workers * (1 + mostReplacements)),
      checkers(given.passwordChecks, given.queue, given.passwordChecks * (1 + mostReplacements)) {}

void Processing::begin(const WorkPointer& work) {
    const std::lock_guard lock(mutex);
    work->started = Work::Clock::now();
    working.insert(work);
    MHD_suspend_connection(work->handle);
    if (Authentication::takesPassword(*work)) {
        work->caller.user = claimedUser(work->http);
        hand(work, checkers, &Processing::authenticate);
    } else {
        hand(work, workers, &Processing::operate);
    }
}

/// Under the lock.
void Processing::hand(const WorkPointer& work, Workers& to, void (Processing::*job)(const WorkPointer&)) {
    work->workers = &to;
    if (!to.post([this, work, job] { (this->*job)(work); })) finish(work, plainAnswer(503, "too many requests"));
}

/// In a thread for passwords.
void Processing::authenticate(const WorkPointer& work) {
    work->note("authentication of its client");
    PasswordCheck check;
    try {
        check = checkPassword(work->http, work->connection->address);
    } catch (const std::exception& error) {
        check.refusal = plainAnswer(500, error.what());
    }
    if (!check.caller) {
        done(work, work->caller, std::move(check.refusal));
        return;
    }
    const std::lock_guard lock(mutex);
    if (work->isFinished()) {
        cameBack(*work);
        return;
    }
    work->connection->caller = std::move(check.caller);
    work->connection->authorization = headerOf(work->http, "Authorization").value_or("");
    work->note({});
    hand(work, workers, &Processing::operate);
}

/// In a worker.
void Processing::operate(const WorkPointer& work) {
    const CurrentWork current(*work);
    work->note("the rights of its client");
    HttpAnswer made;
    Caller caller;
    try {
        caller = authentication.callerOf(*work);
        made = exchange(operations, work->http, caller);
    } catch (const std::exception& error) {
        made = plainAnswer(500, error.what());
    }
    done(work, caller, std::move(made));
}

void Processing::done(const WorkPointer& work, const Caller& caller, HttpAnswer made) {
    const std::lock_guard lock(mutex);
    if (work->isFinished()) {
        cameBack(*work);
        return;
    }
    work->caller = caller;
    finish(work, std::move(made));
}

/// Under the lock. An answer that was given in its place has gone to the client.
void Processing::cameBack(const Work& work) {
    if (work.replaced) work.workers->cameBack();
    log("a request came back after all: " + work.noted());
}

/// Under the lock.
void Processing::finish(const WorkPointer& work, HttpAnswer made) {
    if (!work->finish(std::move(made))) return;
    working.erase(work);
    MHD_resume_connection(work->handle);
}

void Processing::answerForHanging() {
    const std::lock_guard lock(mutex);
    const Work::Clock::time_point now = Work::Clock::now();
    for (const WorkPointer& work : std::set<WorkPointer>(working)) {
        if (now - work->started <= limits.answer) continue;
        const std::string doing = work->noted();
        work->replaced = !doing.empty() && work->workers->replace();
        log("no answer in time: " + (doing.empty() ? "all threads were busy" : doing) +
            (work->replaced || doing.empty() ? "" : "; no other thread takes its place"));
        finish(work, plainAnswer(503, "no answer in time"));
    }
}

bool Processing::stop() {
    // Those that check passwords hand work on to the others.
    const bool checked = checkers.stop();
    const bool ended = workers.stop() && checked;
    const std::lock_guard lock(mutex);
    for (const WorkPointer& work : std::set<WorkPointer>(working)) finish(work, plainAnswer(503, "stopping"));
    return ended;
}

} // namespace endpoint
