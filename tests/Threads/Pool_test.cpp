// A page that one thread makes ready is filled by another.
#include "Port/Pool.h"

#include "Support/Sanitized.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstring>
#include <thread>
#include <vector>

namespace {

namespace Pool = Port::Pool;

constexpr std::size_t ObjectSize = 1024;
constexpr std::size_t ObjectsInPage = (2U << 20U) / ObjectSize;

/// Objects that are destroyed with it.
class Objects {
public:
    Objects() = default;
    Objects(const Objects&) = delete;
    Objects& operator=(const Objects&) = delete;
    ~Objects() {
        for (void* object : objects_) {
            Pool::Free(object);
        }
    }

    void Make(std::size_t count) {
        for (; count > 0; --count) {
            void* const object = Pool::Allocate(ObjectSize, Pool::DesignObjects);
            std::memset(object, static_cast<int>(objects_.size() % 251), ObjectSize);
            objects_.push_back(object);
        }
    }
    bool AreIntact() const {
        for (std::size_t i = 0; i < objects_.size(); ++i) {
            const auto* const bytes = static_cast<const unsigned char*>(objects_[i]);
            if (bytes[0] != i % 251 || bytes[ObjectSize - 1] != i % 251) {
                return false;
            }
        }
        return true;
    }

private:
    std::vector<void*> objects_;
};

TEST(PoolReserve, IsUsedByTheThreadThatNeedsAPage) {
#if defined(ORN_HDL_SANITIZED)
    GTEST_SKIP() << "sanitizers have no pages";
#endif
    std::thread([] {
        Objects objects;
        objects.Make(1);
        {
            Pool::Reserve reserve;
            EXPECT_FALSE(Pool::Reserve::IsFull());
            std::thread([&reserve] { reserve.Replenish(); }).join();
            reserve.Replenish();
            EXPECT_TRUE(Pool::Reserve::IsFull());
            objects.Make(ObjectsInPage);
            EXPECT_FALSE(Pool::Reserve::IsFull());
            reserve.Replenish();
            EXPECT_TRUE(Pool::Reserve::IsFull());
        }
        EXPECT_FALSE(Pool::Reserve::IsFull()) << "what is left is returned";
        objects.Make(ObjectsInPage);
        EXPECT_TRUE(objects.AreIntact());
    }).join();
}

TEST(PoolReserve, ServesSeveralThreads) {
    std::atomic<bool> isDone = false;
    std::vector<std::thread> threads;
    threads.reserve(4);
    for (int i = 0; i < 2; ++i) {
        threads.emplace_back([&isDone] {
            Pool::Reserve reserve;
            while (!isDone) {
                reserve.Replenish();
            }
        });
    }
    for (int i = 0; i < 2; ++i) {
        threads.emplace_back([] {
            Objects objects;
            objects.Make(8 * ObjectsInPage);
            EXPECT_TRUE(objects.AreIntact());
        });
    }
    threads[2].join();
    threads[3].join();
    isDone = true;
    threads[0].join();
    threads[1].join();
    EXPECT_FALSE(Pool::Reserve::IsFull());
}

} // namespace
