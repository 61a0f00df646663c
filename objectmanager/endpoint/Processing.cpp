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
    const std::lock_guard lock(mutex);
    work->started = Work::Clock::now();
    working.insert(work);
    work->caller.user = claimedUser(*work);
    MHD_suspend_connection(work->handle);
    if (authentication.takesPassword(*work)) {
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

/// Whether a job still has to be done when its turn comes: one that waited for too long has been answered.
bool Processing::take(Work& work, const char* doing) {
    const std::lock_guard lock(mutex);
    if (work.isFinished()) return false;
    work.note(doing);
    return true;
}

/// In a thread for passwords.
void Processing::authenticate(const WorkPointer& work) {
    if (!take(*work, "authentication of its client")) return;
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
    const std::lock_guard lock(mutex);
    if (work->isFinished()) {
        cameBack(*work);
        return;
    }
    work->connection->know(std::move(*check.caller));
    work->connection->authorization = headerOf(work->http, "Authorization").value_or("");
    work->note({});
    hand(work, workers, &Processing::operate);
}

/// In a worker.
void Processing::operate(const WorkPointer& work) {
    if (!take(*work, "the rights of its client")) return;
    const CurrentWork current(*work);
    HttpAnswer made;
    try {
        const Caller caller = authentication.callerOf(*work);
        know(*work, caller);
        made = exchange(operations, work->http, caller,
                        [&](const HttpAnswer& asked, bool changes, Caller& by) { permit(*work, asked, changes, by); });
    } catch (const std::exception& error) {
        made = plainAnswer(500, error.what());
    }
    done(work, std::move(made));
}

/// Also for the log line of a request that hangs.
void Processing::know(Work& work, const Caller& caller) {
    const std::lock_guard lock(mutex);
    if (!work.isFinished()) work.caller = caller;
}

/// The last step before an operation: what was given up while the rights were looked up is not carried out.
void Processing::permit(Work& work, const HttpAnswer& asked, bool changes, Caller& caller) const {
    if (changes) caller = authentication.renewed(work, caller);
    const std::lock_guard lock(mutex);
    if (work.isFinished()) throw std::runtime_error("answered already");
    work.asked = asked;
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
        work->hangs = !doing.empty();
        work->replaced = work->hangs && work->workers->replace();
        log("no answer in time: " + (doing.empty() ? "all threads were busy" : doing) +
            (work->replaced || !work->hangs ? "" : "; no other thread takes its place"));
        HttpAnswer late = work->asked; // for the log: what it was about
        late.status = 503;
        late.detail = "no answer in time";
        finish(work, std::move(late));
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
