#include "Port/OrderedWork.h"

#include <algorithm>
#include <csignal>
#include <utility>

namespace Port {

namespace {

/// Blocks all signals in this thread, and in those that it starts, as long as it lives.
class SignalBlock {
public:
    SignalBlock() noexcept {
        sigset_t all;
        sigfillset(&all);
        pthread_sigmask(SIG_SETMASK, &all, &former_);
    }
    SignalBlock(const SignalBlock&) = delete;
    SignalBlock& operator=(const SignalBlock&) = delete;
    ~SignalBlock() { pthread_sigmask(SIG_SETMASK, &former_, nullptr); }

private:
    sigset_t former_;
};

} // namespace

unsigned OrderedWork::GetWorkersFor(unsigned threads) noexcept {
    constexpr unsigned MostByDefault = 8;
    // More are of no use, and each takes memory for its results.
    constexpr unsigned Most = 64;
    if (threads == 0) {
        threads = std::clamp(std::thread::hardware_concurrency(), 1U, MostByDefault);
    }
    return std::min(threads, Most) - 1;
}

OrderedWork::OrderedWork(const Settings& settings, Job job, Pastime pastime)
    : settings_(settings), job_(std::move(job)), pastime_(std::move(pastime)),
      results_(std::max<std::size_t>(settings.ahead, 1)) {
    workers_.reserve(settings_.workers);
    StartWorkers();
}

OrderedWork::~OrderedWork() {
    {
        const Lock lock(mutex_);
        end_ = 0;
    }
    change_.notify_all();
    for (std::thread& worker : workers_) {
        worker.join();
    }
}

void OrderedWork::StartWorkers() {
    // A program's signals are handled by its own threads.
    const SignalBlock block;
    try {
        while (workers_.size() < settings_.workers) {
            workers_.emplace_back([this] { Work(); });
        }
    } catch (const std::exception&) {
        // Those that were started do the work, or `Next` alone.
    }
}

void OrderedWork::Work() {
    Lock lock(mutex_);
    while (begun_ < end_) {
        if (CanBegin()) {
            RunNext(lock);
        } else {
            Wait(lock);
        }
    }
}

/// Waits in a worker for a change.
void OrderedWork::Wait(Lock& lock) {
    if (pastime_) {
        lock.unlock();
        pastime_();
        lock.lock();
    }
    if (begun_ < end_ && !CanBegin()) {
        change_.wait(lock);
    }
}

bool OrderedWork::CanBegin() const noexcept {
    return begun_ < end_ && begun_ - released_ < results_.size() &&
           !(settings_.isSerial && running_ > 0);
}

void OrderedWork::RunNext(Lock& lock) {
    const std::size_t number = begun_++;
    Result& result = results_[PlaceOf(number)];
    ++running_;
    lock.unlock();
    bool exists = true;
    try {
        exists = job_(number);
    } catch (...) {
        result.error = std::current_exception();
    }
    lock.lock();
    --running_;
    result.isDone = true;
    if (!exists) {
        end_ = std::min(end_, number);
    } else if (result.error != nullptr) {
        end_ = std::min(end_, number + 1);
    }
    change_.notify_all();
}

bool OrderedWork::Next() {
    Lock lock(mutex_);
    Release();
    while (given_ < end_) {
        if (Result& result = results_[PlaceOf(given_)]; given_ < begun_ && result.isDone) {
            ++given_;
            if (result.error != nullptr) {
                std::rethrow_exception(std::exchange(result.error, nullptr));
            }
            return true;
        }
        if (CanBegin()) {
            RunNext(lock);
        } else {
            change_.wait(lock);
        }
    }
    return false;
}

/// Gives the place of the result in hand back.
void OrderedWork::Release() noexcept {
    if (released_ < given_) {
        results_[PlaceOf(released_)] = Result();
        ++released_;
        // Waking a thread costs more than many a job: workers that sleep, since no place was free,
        // go on when half of the places are.
        if (begun_ - released_ <= results_.size() / 2) {
            change_.notify_all();
        }
    }
}

} // namespace Port
