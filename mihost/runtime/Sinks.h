#ifndef MIHOST_RUNTIME_SINKS_H
#define MIHOST_RUNTIME_SINKS_H

#include "mihost/runtime/Runtime.h"

#include <cstdio>
#include <mutex>
#include <string>

namespace mihost
{

/**
 * Writes whole lines to a stream, from any thread.
 *
 * The caller owns the stream. The first failure is kept, and nothing is written after it.
 */
class LineWriter
{
public:
    explicit LineWriter(std::FILE* stream);

    /** Adds the line end. */
    void write(std::string line);

    /** Flushes the buffer. @return the errno of the first failure, 0 for none */
    int finish();

private:
    void note(bool written);

    std::FILE* stream_;
    std::mutex lock_;
    int problem_ = 0;
};

/** Log messages as lines for people: level, category, message. The trace log repeats them all, so
 * only the level log is written. */
class HumanLines : public LogSink
{
public:
    explicit HumanLines(LineWriter& out);
    void write(LogMessage const& message) override;

private:
    LineWriter& out_;
};

/**
 * Every logger call, and every added or deleted node, as a JSON object on its own line. Written by
 * hand, so that this library needs only the standard library.
 */
class JsonLines : public LogSink, public NodeObserver
{
public:
    /** Names a node's kind, given its type id. */
    using KindName = char const* (*)(unsigned int nodeType);

    JsonLines(LineWriter& out, KindName kindName);

    void write(LogMessage const& message) override;
    void nodeAdded(IC::Node const& node) override;
    void nodeDeleted(IC::Node const& node) override;

private:
    void writeNode(char const* operation, IC::Node const& node);

    LineWriter& out_;
    KindName kindName_;
};

} // namespace mihost

#endif
