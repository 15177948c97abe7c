#ifndef TESTS_INTERPOSE_CALL_H
#define TESTS_INTERPOSE_CALL_H

#include <atomic>
#include <cerrno>
#include <functional>
#include <type_traits>
#include <utility>
#include <variant>

namespace interpose
{

/** A replaced function: how its calls are counted, and one of them made to fail. */
class AnyCall
{
public:
    explicit AnyCall(char const* name);
    virtual ~AnyCall() = default;
    AnyCall(AnyCall const&) = delete;
    AnyCall& operator=(AnyCall const&) = delete;

    char const* name() const;

    /** From now on calls are counted from one, and the one with this number fails; 0: none does. */
    void failAt(unsigned long number);

    /** Ends counting. @return how many calls were made; what hooks call themselves does not count
     */
    unsigned long stopCounting();

    /** Counts a call. @return whether it is the one to fail */
    bool failsNow();

    /** Restores the state of the program's start. */
    virtual void reset();

private:
    friend void resetAll();

    char const* const name_;
    AnyCall* const next_; // in the list of all
    bool counting_ = false;
    unsigned long failing_ = 0;
    unsigned long made_ = 0;
};

/** Removes all hooks. */
void resetAll();

/** While one exists, calls of its thread are not counted. */
class InHook
{
public:
    InHook();
    ~InHook();
    InHook(InHook const&) = delete;
    InHook& operator=(InHook const&) = delete;
};

template <class Function> class Call;

/**
 * A replaced function. It does what the real one does, unless an answer is set:
 *
 *     libc::hooks().popen = [](char const*, char const*) -> FILE* { return nullptr; };
 */
template <class Result, class... Arguments> class Call<Result(Arguments...)> : public AnyCall
{
public:
    using Function = Result(Arguments...);
    using Failure = std::conditional_t<std::is_void_v<Result>, std::monostate, Result>;

    /** @param failure  what a failing call returns; it also sets errno to EIO */
    explicit Call(char const* name, Failure failure = {}) : AnyCall(name), failure_(failure) {}

    /** From now on this is called instead; null: the real function. */
    Call& operator=(std::function<Function> answer)
    {
        answer_ = std::move(answer);
        return *this;
    }

    explicit operator bool() const
    {
        return static_cast<bool>(answer_);
    }

    std::function<Function> const& answer() const
    {
        return answer_;
    }

    /** From now on this is called before each call; null: nothing. */
    void watch(std::function<void(Arguments...)> watcher)
    {
        watcher_ = std::move(watcher);
    }

    /** The real function, known from the first call on. */
    Function* real() const
    {
        return real_;
    }

    /** What the replacement does. @param next  the real function */
    Result operator()(Function* next, Arguments... arguments)
    {
        real_ = next;
        if (failsNow()) {
            errno = EIO;
            if constexpr (std::is_void_v<Result>)
                return;
            else
                return failure_;
        }
        if (watcher_) {
            InHook const inside;
            watcher_(arguments...);
        }
        if (!answer_)
            return next(arguments...);
        InHook const inside;
        return answer_(arguments...);
    }

    void reset() override
    {
        AnyCall::reset();
        answer_ = nullptr;
        watcher_ = nullptr;
    }

private:
    Failure const failure_;
    std::function<Function> answer_;
    std::function<void(Arguments...)> watcher_;
    std::atomic<Function*> real_{nullptr};
};

} // namespace interpose

#endif
