#include "tests/support/Recording.h"

#include <algorithm>
#include <set>

namespace
{

bool endsWith(std::string const& text, std::string const& end)
{
    return text.size() >= end.size() &&
           text.compare(text.size() - end.size(), end.size(), end) == 0;
}

} // namespace

Recording::Recording()
{
    mihost::setLogSink(this);
}

Recording::~Recording()
{
    mihost::setLogSink(nullptr);
}

void Recording::write(mihost::LogMessage const& message)
{
    std::lock_guard const held(lock_);
    records_.push_back({message.operation == mihost::LogMessage::Operation::Trace, message.function,
                        message.file, message.line, message.category, message.level,
                        message.extra == nullptr, message.first, message.second, message.text});
}

std::vector<LogRecord> Recording::records() const
{
    std::lock_guard const held(lock_);
    return records_;
}

std::vector<std::string> Recording::texts(int level) const
{
    std::vector<std::string> found;
    for (LogRecord const& record : records())
        if (!record.trace && (level == 0 || record.level == level))
            found.push_back(record.text);
    return found;
}

std::vector<std::string> Recording::remarks() const
{
    std::vector<std::string> found = texts();
    found.erase(std::remove_if(found.begin(), found.end(),
                               [](std::string const& text) {
                                   return endsWith(text, ": entry") || endsWith(text, ": exit");
                               }),
                found.end());
    return found;
}

std::vector<std::string> Recording::sources() const
{
    std::set<std::string> found;
    for (LogRecord const& record : records())
        found.insert(record.function + ' ' + record.file + ' ' + record.category);
    return {found.begin(), found.end()};
}

bool Recording::has(std::string const& text, int level) const
{
    std::vector<std::string> const found = texts(level);
    return std::find(found.begin(), found.end(), text) != found.end();
}

void Recording::clear()
{
    std::lock_guard const held(lock_);
    records_.clear();
}
