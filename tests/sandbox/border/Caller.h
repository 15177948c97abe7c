#ifndef TESTS_SANDBOX_BORDER_CALLER_H
#define TESTS_SANDBOX_BORDER_CALLER_H

#include "mihost/sandbox/Descriptor.h"
#include "mihost/sandbox/Sandbox.h"

#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <sys/types.h>

/**
 * A process that calls enterSandbox, seen from the machine itself.
 *
 * The code given runs inside the copy, which talks to the test through a pipe. The pipe ends when
 * every process of the copy is gone.
 */
class Caller
{
public:
    using Inside = std::function<int()>;

    /**
     * @param inside   what runs in the copy; its result is the exit code
     * @param overlay  a directory to lay over the copy
     * @param before   what the calling process does first
     */
    explicit Caller(
        Inside inside, std::string const& overlay = "",
        std::function<void()> const& before = [] {});
    ~Caller();
    Caller(Caller const&) = delete;
    Caller& operator=(Caller const&) = delete;

    /** Sends text to the test, from inside. */
    static void say(std::string const& text);

    /** Says "." from inside, then waits for signals. */
    [[noreturn]] static void sayAndWait();

    /** Says from inside what the working directory is. */
    static void sayWorkingDirectory();

    /** Reads as many bytes; fewer if every process of the copy is gone before. */
    std::string hear(std::size_t length);

    /** Reads until every process of the copy is gone. */
    std::string hearAll();

    void send(int signal) const;

    /** Waits for the calling process. @return its wait status */
    int wait();

private:
    static int writer;

    mihost::Descriptor readEnd_;
    pid_t process_;
};

/** Gives the calling process its own mounts, which no other process sees. */
void ownMounts();

/** The same, with an empty file system there. */
void mountOwnDisk(std::string const& path);

/** Continues in a child, and lets this process run the step and end as the child did. */
void continueInChild(std::function<void()> const& atItsEnd);

/** Whether anything is there, even a dangling link. */
bool exists(std::string const& path);

/** Skips its tests if no copy can be made, unless MI_SANDBOX_REQUIRED is 1. */
class BorderTest : public testing::Test
{
protected:
    void SetUp() override;
};

#endif
