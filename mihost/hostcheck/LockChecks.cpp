// The lock, by one thread and by two.

#include "host/Mutex.h"
#include "mihost/hostcheck/Check.h"

#include <atomic>
#include <chrono>
#include <climits>
#include <thread>

namespace hostcheck
{

namespace
{

constexpr unsigned long withoutLimit = 0xFFFFFFFFUL;
constexpr int shortWait = 20; // milliseconds

struct Answer {
    int result;
    std::chrono::milliseconds waited;
};

/** What lock answers in another thread, which releases a lock that it got at once. */
Answer lockElsewhere(NQ::Mutex& mutex, unsigned long timeout)
{
    using Clock = std::chrono::steady_clock;
    Answer answer{};
    std::thread([&] {
        auto const start = Clock::now();
        answer.result = mutex.lock(timeout);
        answer.waited = std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - start);
        if (answer.result == 0)
            mutex.unlock();
    }).join();
    return answer;
}

std::string locks()
{
    for (unsigned long const timeout : {withoutLimit, ULONG_MAX, 0UL, 1UL}) {
        NQ::Mutex mutex;
        if (mutex.lock(timeout) != 0)
            return "a free lock is not taken with a time limit of " + std::to_string(timeout);
        mutex.unlock();
    }
    return "";
}

std::string unlocks()
{
    NQ::Mutex mutex;
    mutex.lock(withoutLimit);
    int const result = mutex.unlock();
    return firstOf({equal("the result", result, 0),
                    equal("lock in another thread afterwards", lockElsewhere(mutex, 0).result, 0)});
}

std::string excludes()
{
    NQ::Mutex mutex;
    mutex.lock(withoutLimit);
    int const result = lockElsewhere(mutex, 0).result;
    mutex.unlock();
    return holds(result != 0, "another thread takes a lock that is held");
}

std::string waitsForTheTime()
{
    constexpr int limit = 100;
    constexpr int early = limit / 2; // clocks differ, units differ more
    NQ::Mutex mutex;
    mutex.lock(withoutLimit);
    Answer const answer = lockElsewhere(mutex, limit);
    mutex.unlock();
    return firstOf({holds(answer.result != 0, "another thread takes a lock that is held"),
                    holds(answer.waited.count() >= early,
                          "a time limit of 100 ends after " +
                              std::to_string(answer.waited.count()) + " milliseconds")});
}

std::string waitsWithoutLimit()
{
    NQ::Mutex mutex;
    std::atomic<bool> started{false};
    std::atomic<bool> released{false};
    bool early = false;
    int result = -1;
    mutex.lock(withoutLimit);
    std::thread other([&] {
        started = true;
        result = mutex.lock(withoutLimit);
        early = !released;
        if (result == 0)
            mutex.unlock();
    });
    while (!started)
        std::this_thread::yield();
    std::this_thread::sleep_for(std::chrono::milliseconds(shortWait)); // until it waits
    released = true;
    mutex.unlock();
    other.join();
    return firstOf({equal("the result", result, 0), holds(!early, "it does not wait")});
}

std::string keepsOthersOut()
{
    NQ::Mutex mutex;
    std::atomic<bool> inside{false};
    std::atomic<int> meetings{0};
    auto const work = [&] {
        for (int round = 0; round < 1000; ++round) {
            mutex.lock(withoutLimit);
            if (inside.exchange(true))
                ++meetings;
            std::this_thread::yield();
            inside = false;
            mutex.unlock();
        }
    };
    std::thread other(work);
    work();
    other.join();
    return holds(meetings == 0, "two threads hold the lock at the same time");
}

} // namespace

Checks lockChecks()
{
    constexpr char const* lock = "NQ::Mutex::lock";
    return {
        {lock, "takes a free lock and returns 0", locks},
        {"NQ::Mutex::unlock", "releases the lock and returns 0", unlocks},
        {lock, "fails while another thread holds the lock", excludes},
        {lock, "waits for the time limit in milliseconds", waitsForTheTime},
        {lock, "waits without limit for 0xFFFFFFFF", waitsWithoutLimit},
        {lock, "lets one thread in at a time", keepsOthersOut},
    };
}

} // namespace hostcheck
