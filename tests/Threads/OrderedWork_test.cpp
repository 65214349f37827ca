// Results come in the order of the jobs, whichever thread ends first, and nothing is left running.
#include "Port/OrderedWork.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <csignal>
#include <stdexcept>
#include <string>
#include <thread>
#include <utility>
#include <vector>

namespace {

using Port::OrderedWork;

constexpr std::size_t Jobs = 200;

/// Jobs take different times.
void Linger(std::size_t number) {
    for (std::size_t i = 0; i < number * 7 % 5; ++i) {
        std::this_thread::yield();
    }
}

/// The numbers of the jobs in the order in which their results are given.
std::vector<std::size_t> GivenBy(const OrderedWork::Settings& settings) {
    std::vector<std::size_t> places(settings.ahead);
    OrderedWork work(settings, [&](std::size_t number) {
        Linger(number);
        places[number % settings.ahead] = number;
        return number < Jobs;
    });
    std::vector<std::size_t> given;
    while (work.Next()) {
        given.push_back(places[work.GetPlace()]);
    }
    EXPECT_FALSE(work.Next());
    return given;
}

std::vector<std::size_t> Ascending(std::size_t count) {
    std::vector<std::size_t> numbers(count);
    for (std::size_t i = 0; i < count; ++i) {
        numbers[i] = i;
    }
    return numbers;
}

TEST(OrderedWork, ResultsComeInOrder) {
    for (const unsigned workers : {0U, 1U, 2U, 7U}) {
        for (const std::size_t ahead : {1U, 2U, 3U, 20U}) {
            for (const bool isSerial : {false, true}) {
                EXPECT_EQ(GivenBy({workers, ahead, isSerial}), Ascending(Jobs))
                    << workers << ' ' << ahead << ' ' << isSerial;
            }
        }
    }
}

TEST(OrderedWork, WithoutJobsThereIsNoResult) {
    OrderedWork work({2, 3, false}, [](std::size_t) { return false; });
    EXPECT_FALSE(work.Next());
    EXPECT_FALSE(work.Next());
}

TEST(OrderedWork, NoMoreJobsAreBegunThanAskedFor) {
    std::atomic<std::size_t> begun = 0;
    OrderedWork work({3, 4, false}, [&](std::size_t number) {
        begun = std::max(begun.load(), number + 1);
        return number < Jobs;
    });
    for (std::size_t given = 1; work.Next(); ++given) {
        // The result in hand takes a place as long as it is in hand.
        EXPECT_LE(begun, given + 3);
    }
}

TEST(OrderedWork, SerialJobsNeverMeet) {
    std::atomic<int> running = 0;
    std::size_t next = 0;
    OrderedWork work({3, 4, true}, [&](std::size_t number) {
        EXPECT_EQ(++running, 1);
        EXPECT_EQ(next++, number);
        Linger(number);
        --running;
        return number < Jobs;
    });
    while (work.Next()) {
    }
    EXPECT_EQ(next, Jobs + 1);
}

TEST(OrderedWork, AnExceptionComesInItsPlaceAndEndsTheWork) {
    for (const unsigned workers : {0U, 2U}) {
        std::vector<std::size_t> given;
        OrderedWork work({workers, 5, false}, [](std::size_t number) {
            Linger(number);
            if (number % 10 == 7) {
                throw std::runtime_error(std::to_string(number));
            }
            return true;
        });
        try {
            while (work.Next()) {
                given.push_back(work.GetPlace());
            }
            ADD_FAILURE() << "no exception";
        } catch (const std::runtime_error& error) {
            EXPECT_STREQ(error.what(), "7");
        }
        EXPECT_EQ(given, (std::vector<std::size_t>{0, 1, 2, 3, 4, 0, 1}));
        EXPECT_FALSE(work.Next());
    }
}

TEST(OrderedWork, MayEndBeforeItsResultsAreTaken) {
    std::atomic<int> running = 0;
    for (int taken = 0; taken < 5; ++taken) {
        OrderedWork work({2, 3, false}, [&](std::size_t number) {
            ++running;
            Linger(number);
            --running;
            return true;
        });
        for (int i = 0; i < taken; ++i) {
            EXPECT_TRUE(work.Next());
        }
    }
    EXPECT_EQ(running, 0);
}

TEST(OrderedWork, WorkersHaveAPastimeBeforeTheyWait) {
    for (const unsigned workers : {1U, 3U}) {
        std::atomic<int> pastimes = 0;
        {
            OrderedWork work(
                {workers, 2}, [](std::size_t number) { return number < Jobs; },
                [&pastimes] { ++pastimes; });
            // No job can begin once both places are taken.
            while (pastimes == 0) {
                std::this_thread::yield();
            }
            std::size_t given = 0;
            while (work.Next()) {
                ++given;
            }
            EXPECT_EQ(given, Jobs);
        }
        EXPECT_GT(pastimes, 0);
    }
    bool hadPastime = false;
    OrderedWork alone(
        {0, 2}, [](std::size_t number) { return number < Jobs; },
        [&hadPastime] { hadPastime = true; });
    while (alone.Next()) {
    }
    EXPECT_FALSE(hadPastime) << "the owner has none";
}

TEST(OrderedWork, WithoutWorkersTheOwnerDoesAll) {
    const std::thread::id owner = std::this_thread::get_id();
    OrderedWork work({0, 2, false}, [&](std::size_t number) {
        EXPECT_EQ(std::this_thread::get_id(), owner);
        return number < 3;
    });
    while (work.Next()) {
    }
}

TEST(OrderedWork, OneThreadHasNoWorkers) {
    EXPECT_EQ(OrderedWork::GetWorkersFor(1), 0U);
    EXPECT_EQ(OrderedWork::GetWorkersFor(5), 4U);
    EXPECT_LT(OrderedWork::GetWorkersFor(0), 8U);
    EXPECT_LT(OrderedWork::GetWorkersFor(static_cast<unsigned>(-1)), 100U);
}

std::atomic<bool> wasHandledByOwner = false;
std::thread::id ownerOfSignals;

TEST(OrderedWork, WorkersLeaveSignalsToTheProgram) {
    ownerOfSignals = std::this_thread::get_id();
    const auto handler = [](int) {
        wasHandledByOwner = std::this_thread::get_id() == ownerOfSignals;
    };
    struct sigaction action = {};
    struct sigaction former;
    action.sa_handler = handler;
    ASSERT_EQ(sigaction(SIGUSR1, &action, &former), 0);
    OrderedWork work({3, 4, false}, [](std::size_t number) {
        sigset_t blocked;
        pthread_sigmask(SIG_SETMASK, nullptr, &blocked);
        const bool isWorker = std::this_thread::get_id() != ownerOfSignals;
        EXPECT_EQ(sigismember(&blocked, SIGUSR1) == 1, isWorker);
        Linger(number);
        return number < Jobs;
    });
    while (work.Next()) {
    }
    kill(getpid(), SIGUSR1);
    EXPECT_TRUE(wasHandledByOwner);
    sigaction(SIGUSR1, &former, nullptr);
}

} // namespace
