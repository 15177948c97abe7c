// The reference runtime's lock.

#include "host/Mutex.h"

#include <gtest/gtest.h>

#include <atomic>
#include <fstream>
#include <string>
#include <thread>

namespace mutex_test
{

using NQ::Mutex;

constexpr unsigned long withoutLimit = 0xFFFFFFFF;

/** Another thread, which tries to lock the mutex and then unlocks it. */
class Other
{
public:
    Other(Mutex& mutex, unsigned long timeout)
        : thread_([this, &mutex, timeout] {
              id_ = gettid();
              result_ = mutex.lock(timeout);
              finished_ = true;
              if (result_ == 0)
                  mutex.unlock();
          })
    {
    }

    /** Waits until the thread sleeps or has finished. @return whether it sleeps */
    bool waits() const
    {
        while (!finished_)
            if (id_ != 0 && sleeps())
                return true;
        return false;
    }

    int result()
    {
        thread_.join();
        return result_;
    }

private:
    bool sleeps() const
    {
        std::ifstream file("/proc/self/task/" + std::to_string(id_) + "/stat");
        std::string text;
        std::getline(file, text);
        std::string::size_type const state = text.rfind(") ");
        return state != std::string::npos && text[state + 2] == 'S';
    }

    std::atomic<pid_t> id_{0};
    std::atomic<bool> finished_{false};
    std::atomic<int> result_{-1};
    std::thread thread_;
};

TEST(Mutex, IsLockedAndUnlocked)
{
    Mutex mutex;
    EXPECT_EQ(mutex.lock(withoutLimit), 0);
    EXPECT_EQ(mutex.unlock(), 0);
    EXPECT_EQ(mutex.lock(0), 0);
    EXPECT_EQ(mutex.unlock(), 0);
}

TEST(Mutex, IsNotLockedIfTheTimeRunsOut)
{
    Mutex mutex;
    ASSERT_EQ(mutex.lock(withoutLimit), 0);
    EXPECT_NE(Other(mutex, 0).result(), 0);
    EXPECT_NE(Other(mutex, 1).result(), 0);
    mutex.unlock();
    EXPECT_EQ(Other(mutex, 0).result(), 0);
}

TEST(Mutex, IsWaitedForWithoutLimitWhenAllBitsAreSet)
{
    for (unsigned long const timeout : {withoutLimit, ~0UL}) {
        Mutex mutex;
        ASSERT_EQ(mutex.lock(withoutLimit), 0);
        Other other(mutex, timeout);
        EXPECT_TRUE(other.waits());
        mutex.unlock();
        EXPECT_EQ(other.result(), 0);
    }
}

TEST(Mutex, IsLockedInTimeAfterAnUnlock)
{
    Mutex mutex;
    ASSERT_EQ(mutex.lock(withoutLimit), 0);
    Other other(mutex, 100000);
    EXPECT_TRUE(other.waits());
    mutex.unlock();
    EXPECT_EQ(other.result(), 0);
}

TEST(Mutex, LetsOneThreadInAtATime)
{
    Mutex mutex;
    int counter = 0;
    auto const count = [&] {
        for (int i = 0; i < 10000; ++i) {
            mutex.lock(withoutLimit);
            ++counter;
            mutex.unlock();
        }
    };
    std::thread other(count);
    count();
    other.join();
    EXPECT_EQ(counter, 20000);
}

} // namespace mutex_test
