// Assembling log messages, and the log, of which only this side of the calls can be seen.

#include "host/VXLogger.h"
#include "host/VXMessageBuffer.h"
#include "mihost/hostcheck/Check.h"

#include <climits>
#include <ostream>
#include <thread>

namespace hostcheck
{

namespace
{

using VXLog::VXLogger;
using VXLog::VXMessageBuffer;

std::string buffersLiteral()
{
    VXMessageBuffer buffer;
    VXMessageBuffer& end = buffer << "100% "
                                  << "text";
    return firstOf({holds(&end == &buffer, "the result is not the buffer"),
                    equal("the message", buffer.str(end), "100% text")});
}

std::string buffersArray()
{
    char text[] = "text";
    VXMessageBuffer buffer;
    return equal("the message", buffer.str(buffer << static_cast<char*>(text)), "text");
}

std::string buffersString()
{
    for (std::string const& text : oddTexts()) {
        VXMessageBuffer buffer;
        std::string problem = equal("the message", buffer.str(buffer << text), text);
        if (!problem.empty())
            return problem;
    }
    return "";
}

template <class Number> std::string buffers(Number number)
{
    VXMessageBuffer buffer;
    std::ostream& end = buffer << number;
    return equal("the message", buffer.str(end), std::to_string(number));
}

std::string buffersInt()
{
    return firstOf({buffers(0), buffers(INT_MIN), buffers(INT_MAX)});
}

std::string buffersUnsigned()
{
    return firstOf({buffers(0U), buffers(UINT_MAX)});
}

std::string buffersInOrder()
{
    VXMessageBuffer buffer;
    std::ostream& end = buffer << "a" << std::string("b") << 1 << "c" << 'd';
    return equal("the message", buffer.str(end), "ab1cd");
}

std::string buffersInSteps()
{
    VXMessageBuffer buffer;
    buffer << 1;
    buffer << "a";
    buffer << 2U << "b";
    return equal("the message", buffer.str(buffer << std::string("c")), "1a2bc");
}

std::string buffersNothing()
{
    VXMessageBuffer buffer;
    return equal("the message", buffer.str(buffer), "");
}

// The two operations of the log take the same arguments.

using LogOperation = decltype(&VXLogger::logLevelMessage);

template <LogOperation Log> void say(std::string const& message, int level)
{
    Log("initialize", "hostcheck", __LINE__, "Veltrix.IC.MI.HostCheck", level, nullptr, 0, 0,
        message);
}

template <LogOperation Log> std::string takesEveryLevel()
{
    for (int const level : {VXLog::level::progress, VXLog::level::power, VXLog::level::error})
        say<Log>("hostcheck: a message of level " + std::to_string(level), level);
    return "";
}

template <LogOperation Log> std::string takesOddTexts()
{
    for (std::string const& text : oddTexts())
        say<Log>(text, VXLog::level::progress);
    return "";
}

template <LogOperation Log> std::string takesTwoThreads()
{
    auto const talk = [] {
        for (int round = 0; round < 100; ++round)
            say<Log>("hostcheck: round " + std::to_string(round), VXLog::level::progress);
    };
    std::thread other(talk);
    talk();
    other.join();
    return "";
}

} // namespace

Checks logChecks()
{
    constexpr char const* literal = "VXLog::VXMessageBuffer::operator<<(char const*)";
    constexpr char const* log = "VXLog::VXLogger::logLevelMessage";
    constexpr char const* trace = "VXLog::VXLogger::traceLevelMessage";
    constexpr char const* levels = "takes every level, with a null extra argument";
    constexpr char const* odd = "takes empty, long and odd texts as they are";
    constexpr char const* threads = "may be called from two threads";
    return {
        {"VXLog::VXMessageBuffer::str(VXMessageBuffer&)", "is empty at first", buffersNothing},
        {literal, "appends and returns the buffer", buffersLiteral},
        {"VXLog::VXMessageBuffer::operator<<(char*)", "appends", buffersArray},
        {"VXLog::VXMessageBuffer::operator<<(std::string const&)", "appends every byte",
         buffersString},
        {"VXLog::VXMessageBuffer::operator<<(int)", "appends in decimal", buffersInt},
        {"VXLog::VXMessageBuffer::operator<<(unsigned int)", "appends in decimal", buffersUnsigned},
        {"VXLog::VXMessageBuffer::str(std::ostream&)", "has text and numbers in order",
         buffersInOrder},
        {literal, "appends after a number", buffersInSteps},
        {log, levels, takesEveryLevel<VXLogger::logLevelMessage>},
        {log, odd, takesOddTexts<VXLogger::logLevelMessage>},
        {log, threads, takesTwoThreads<VXLogger::logLevelMessage>},
        {trace, levels, takesEveryLevel<VXLogger::traceLevelMessage>},
        {trace, odd, takesOddTexts<VXLogger::traceLevelMessage>},
        {trace, threads, takesTwoThreads<VXLogger::traceLevelMessage>},
    };
}

} // namespace hostcheck
