#include "objectmanager/endpoint/Processing.h"

#include "objectmanager/endpoint/Log.h"

#include <microhttpd.h>

#include <stdexcept>

namespace endpoint {
namespace {

constexpr std::size_t mostReplacements = 3; ///< for each thread

} // namespace

Processing::Processing(Operations& asked, const Authentication& by, const Limits& given)
    : operations(asked), authentication(by), limits(given),
      workers(given.workers, given.queue, given.workers * (1 + mostReplacements)),
      checkers(given.passwordChecks, given.queue, given.passwordChecks * (1 + mostReplacements)) {}

void Processing::begin(const WorkPointer& work) {
    work->started = Work::Clock::now();
    work->caller.user = claimedUser(*work);
    MHD_suspend_connection(work->handle);
    {
        const std::lock_guard lock(mutex);
        working.insert(work);
    }
    if (authentication.takesPassword(*work)) {
        hand(work, checkers, &Processing::authenticate);
    } else {
        hand(work, workers, &Processing::operate);
    }
}

/// Without the lock: the thread that is woken would wait for it.
void Processing::hand(const WorkPointer& work, Workers& to, void (Processing::*job)(const WorkPointer&)) {
    {
        const std::lock_guard lock(mutex);
        work->workers = &to;
    }
    if (to.post([this, work, job] { (this->*job)(work); })) return;
    const std::lock_guard lock(mutex);
    finish(work, plainAnswer(503, "too many requests"));
}

/// In a thread for passwords.
void Processing::authenticate(const WorkPointer& work) {
    if (!work->start("authentication of its client")) return; // it waited for too long and was answered
    PasswordCheck check;
    try {
        check = checkPassword(work->http, work->connection->address);
    } catch (const std::exception& error) {
        check.refusal = plainAnswer(500, error.what());
    }
    if (!check.caller) {
        done(work, std::move(check.refusal));
        return;
    }
    {
        const std::lock_guard lock(mutex);
        if (work->isFinished()) {
            cameBack(*work);
            return;
        }
        work->connection->know(std::move(*check.caller));
        work->connection->authorization = headerOf(work->http, "Authorization").value_or("");
        work->note({});
    }
    hand(work, workers, &Processing::operate);
}

/// In a worker.
void Processing::operate(const WorkPointer& work) {
    if (!work->start("the rights of its client")) return;
    const CurrentWork current(*work);
    HttpAnswer made;
    try {
        const Caller caller = authentication.callerOf(*work);
        work->know(caller); // also for the log line of a request that hangs
        const Permit permission = [&](const HttpAnswer& asked, bool changes, Caller& by) {
            permit(*work, asked, changes, by);
        };
        made = exchange(operations, work->http, caller, permission, limits.wholeAnswer);
    } catch (const std::exception& error) {
        made = plainAnswer(500, error.what());
    }
    done(work, std::move(made));
}

/// The last step before an operation: what was given up while the rights were looked up is not carried out.
void Processing::permit(Work& work, const HttpAnswer& asked, bool changes, Caller& caller) const {
    if (changes) caller = authentication.renewed(work, caller);
    if (!work.ask(asked)) throw std::runtime_error("answered already");
}

void Processing::done(const WorkPointer& work, HttpAnswer made) {
    const std::lock_guard lock(mutex);
    if (work->isFinished()) {
        cameBack(*work);
        return;
    }
    finish(work, std::move(made));
}

/// Under the lock. An answer that was given in its place has gone to the client.
void Processing::cameBack(const Work& work) {
    if (work.hangs) work.workers->cameBack(work.replaced);
    log("a request came back after all: " + work.noted());
}

/// Under the lock.
void Processing::finish(const WorkPointer& work, HttpAnswer made) {
    if (work->finish(std::move(made))) resume(work);
}

/// Under the lock.
void Processing::resume(const WorkPointer& work) {
    working.erase(work);
    MHD_resume_connection(work->handle);
}

void Processing::answerForHanging() {
    const std::lock_guard lock(mutex);
    const Work::Clock::time_point now = Work::Clock::now();
    for (const WorkPointer& work : std::set<WorkPointer>(working)) {
        if (now - work->started <= limits.answer) continue;
        HttpAnswer late = work->question(); // for the log: what it was about
        late.status = 503;
        late.detail = "no answer in time";
        if (!work->finish(std::move(late))) continue;
        // From here on no thread begins with it: one that has is one that hangs.
        const std::string doing = work->noted();
        work->hangs = !doing.empty();
        work->replaced = work->hangs && work->workers->replace();
        log("no answer in time: " + (doing.empty() ? "all threads were busy" : doing) +
            (work->replaced || !work->hangs ? "" : "; no other thread takes its place"));
        resume(work);
    }
}

bool Processing::stop() {
    // Those that check passwords hand work on to the others.
    const bool checked = checkers.stop(std::chrono::milliseconds(0), limits.endingOfHanging);
    const bool ended = workers.stop(limits.ending, limits.endingOfHanging) && checked;
    const std::lock_guard lock(mutex);
    for (const WorkPointer& work : std::set<WorkPointer>(working)) finish(work, plainAnswer(503, "stopping"));
    return ended;
}

} // namespace endpoint
