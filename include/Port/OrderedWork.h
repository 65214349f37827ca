/// \file
/// Work for several threads whose results are needed in order.
#pragma once

#include "Port/Export.h"

#include <condition_variable>
#include <cstddef>
#include <exception>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

namespace Port {

/// Runs numbered jobs in threads of its own and hands their results to its owner in the order of
/// the numbers. The results are the jobs' affair: job `n` leaves its result in place
/// `GetPlace(n)` of some array of the owner's, where no other job writes until the owner has done
/// with it.
///
/// \code
/// OrderedWork work({1, 4}, [&](std::size_t n) { return Make(n, results[n % 4]); });
/// while (work.Next()) {
///     Use(results[work.GetPlace()]);
/// }
/// \endcode
///
/// The owner uses it from one thread. While it waits for a result, it runs jobs itself.
class ORN_HDL_API OrderedWork {
public:
    /// How the work is shared out.
    struct Settings {
        /// How many threads run jobs besides the owner. 0 creates no thread: `Next` runs each job.
        unsigned workers = 0;
        /// How many jobs can be begun whose results the owner has not done with; at least 1.
        std::size_t ahead = 1;
        /// Whether the jobs run one after the other, in their order, each in any thread.
        bool isSerial = false;
    };
    /// Carries out the job of a number, 0 for the first. \return false if there is no such job and
    /// none of a higher number. What it throws is thrown by the `Next` that would give its result.
    using Job = std::function<bool(std::size_t number)>;
    /// What a worker does, once, before it waits for a job that can begin; may be empty. Throws
    /// nothing.
    using Pastime = std::function<void()>;

    /// How many workers make up that many threads together with the owner; 0 threads are as many as
    /// the system gives, at most 8.
    static unsigned GetWorkersFor(unsigned threads) noexcept;

    /// Begins. If the system gives fewer threads than asked for, the work is done by those there
    /// are.
    OrderedWork(const Settings& settings, Job job, Pastime pastime = {});
    OrderedWork(const OrderedWork&) = delete;
    OrderedWork& operator=(const OrderedWork&) = delete;
    /// Begins no more jobs and waits for those that run.
    ~OrderedWork();

    /// Waits for the next result. The owner has done with the one before.
    /// \return false if there is none, or if the one before was an exception.
    bool Next();
    /// The place of the result that `Next` has given: its job's number modulo `Settings::ahead`.
    std::size_t GetPlace() const noexcept { return PlaceOf(given_ - 1); }

private:
    struct Result {
        bool isDone = false;
        std::exception_ptr error;
    };
    using Lock = std::unique_lock<std::mutex>;

    std::size_t PlaceOf(std::size_t number) const noexcept { return number % results_.size(); }
    void StartWorkers();
    void Work();
    void Wait(Lock& lock);
    bool CanBegin() const noexcept;
    void RunNext(Lock& lock);
    void Release() noexcept;

    const Settings settings_;
    const Job job_;
    const Pastime pastime_;
    std::mutex mutex_;
    /// A job has ended, a result was released, or no more jobs begin.
    std::condition_variable change_;
    std::vector<Result> results_;
    std::size_t begun_ = 0;
    std::size_t running_ = 0;
    std::size_t given_ = 0;
    std::size_t released_ = 0;
    /// No job has this number or a higher one.
    std::size_t end_ = static_cast<std::size_t>(-1);
    std::vector<std::thread> workers_;
};

} // namespace Port
