#include "mihost/runtime/Sinks.h"

#include "host/MutableNode.h"
#include "mihost/runtime/Text.h"

#include <cerrno>
#include <utility>

namespace mihost
{

LineWriter::LineWriter(std::FILE* stream) : stream_(stream) {}

void LineWriter::note(bool written)
{
    if (!written && problem_ == 0)
        problem_ = errno != 0 ? errno : EIO;
}

void LineWriter::write(std::string line)
{
    line += '\n';
    std::lock_guard const held(lock_);
    if (problem_ == 0)
        note(std::fwrite(line.data(), 1, line.size(), stream_) == line.size());
}

int LineWriter::finish()
{
    std::lock_guard const held(lock_);
    if (problem_ == 0)
        note(std::fflush(stream_) == 0);
    return problem_;
}

HumanLines::HumanLines(LineWriter& out) : out_(out) {}

void HumanLines::write(LogMessage const& message)
{
    if (message.operation == LogMessage::Operation::Log)
        out_.write(std::to_string(message.level) + " " + message.category + ": " +
                   printable(message.text));
}

JsonLines::JsonLines(LineWriter& out, KindName kindName) : out_(out), kindName_(kindName) {}

void JsonLines::write(LogMessage const& message)
{
    constexpr std::size_t usualLength = 255;
    std::string line;
    line.reserve(usualLength);
    line +=
        message.operation == LogMessage::Operation::Trace ? "{\"op\":\"trace\"" : "{\"op\":\"log\"";
    line += ",\"function\":";
    appendJsonString(line, message.function);
    line += ",\"file\":";
    appendJsonString(line, message.file);
    line += ",\"line\":" + std::to_string(message.line) + ",\"category\":";
    appendJsonString(line, message.category);
    line += ",\"level\":" + std::to_string(message.level) + ",\"message\":";
    appendJsonString(line, message.text);
    line += '}';
    out_.write(std::move(line));
}

void JsonLines::nodeAdded(IC::Node const& node)
{
    writeNode("node-added", node);
}

void JsonLines::nodeDeleted(IC::Node const& node)
{
    writeNode("node-deleted", node);
}

void JsonLines::writeNode(char const* operation, IC::Node const& node)
{
    if (auto const* known = dynamic_cast<IC::MutableNode const*>(&node))
        out_.write("{\"op\":" + jsonString(operation) +
                   ",\"id\":" + std::to_string(known->getNodeId()) +
                   ",\"kind\":" + jsonString(kindName_(known->getNodeType())) + "}");
}

} // namespace mihost
