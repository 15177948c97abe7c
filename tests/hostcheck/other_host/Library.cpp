// The lock, texts and the log of this host.

#include "host/Mutex.h"
#include "host/VXLogger.h"
#include "host/VXMessageBuffer.h"
#include "host/make_string.h"
#include "tests/hostcheck/other_host/Broken.h"

#include <chrono>
#include <condition_variable>
#include <deque>
#include <mutex>
#include <sstream>

namespace NQ
{

// A flag that a standard mutex guards.
struct Mutex::Handle {
    std::mutex guard;
    std::condition_variable released;
    bool held = false;
};

Mutex::Mutex() : handle_(new Handle) {}

Mutex::~Mutex() = default;

int Mutex::lock(unsigned long timeout)
{
    auto const isFree = [this] { return !handle_->held || broken(Way::LockExcludesNobody); };
    std::unique_lock<std::mutex> guard(handle_->guard);
    auto const limit = std::chrono::milliseconds(broken(Way::LockIgnoresTheTime) ? 0 : timeout);
    if (timeout >= 0xFFFFFFFFUL)
        handle_->released.wait(guard, isFree);
    else if (!handle_->released.wait_for(guard, limit, isFree))
        return -1;
    handle_->held = true;
    return 0;
}

int Mutex::unlock()
{
    std::lock_guard<std::mutex> const guard(handle_->guard);
    handle_->held = false;
    handle_->released.notify_one();
    return broken(Way::UnlockReturnsOne) ? 1 : 0;
}

namespace
{

// A byte that is not UTF-8 becomes a wide character beyond those of Unicode.
constexpr unsigned long firstStray = 0x110000;

/** The size in bytes of the character at this place; 0 if it is not UTF-8. */
std::size_t sizeOfCharacter(std::string const& text, std::size_t at)
{
    auto const byte = [&](std::size_t place) {
        return place < text.size() ? static_cast<unsigned char>(text[place]) : 0U;
    };
    unsigned int const first = byte(at);
    std::size_t const size = first < 0x80                    ? 1
                             : first >= 0xC2 && first < 0xE0 ? 2
                             : first >= 0xE0 && first < 0xF0 ? 3
                             : first >= 0xF0 && first < 0xF5 ? 4
                                                             : 0;
    for (std::size_t next = 1; next < size; ++next)
        if (byte(at + next) < 0x80 || byte(at + next) > 0xBF)
            return 0;
    unsigned int const second = byte(at + 1);
    bool const overlong = (first == 0xE0 && second < 0xA0) || (first == 0xF0 && second < 0x90);
    bool const outside = (first == 0xED && second > 0x9F) || (first == 0xF4 && second > 0x8F);
    return overlong || outside ? 0 : size;
}

} // namespace

std::string make_string(char const* text)
{
    if (!text && !broken(Way::NullTextIsRead))
        return {};
    std::string copy;
    for (; *text; ++text)
        copy += *text;
    return copy;
}

std::string make_string(std::wstring const& text)
{
    std::string narrow;
    for (wchar_t const wide : text) {
        auto const code = static_cast<unsigned long>(wide);
        auto const tail = [&](unsigned int shift) {
            narrow += static_cast<char>(0x80 | ((code >> shift) & 0x3F));
        };
        if (code >= firstStray) {
            narrow += static_cast<char>(code - firstStray);
        } else if (code < 0x80) {
            narrow += static_cast<char>(code);
        } else if (code < 0x800) {
            narrow += static_cast<char>(0xC0 | code >> 6);
            tail(0);
        } else if (code < 0x10000) {
            narrow += static_cast<char>(0xE0 | code >> 12);
            tail(6);
            tail(0);
        } else {
            narrow += static_cast<char>(0xF0 | code >> 18);
            tail(12);
            tail(6);
            tail(0);
        }
    }
    return narrow;
}

std::wstring make_wstring(std::string const& text)
{
    std::wstring wide;
    for (std::size_t at = 0; at < text.size();) {
        std::size_t const size = sizeOfCharacter(text, at);
        auto const first = static_cast<unsigned char>(text[at++]);
        if (size == 0) {
            wide +=
                static_cast<wchar_t>(broken(Way::StrayBytesAreReplaced) ? '?' : firstStray + first);
            continue;
        }
        unsigned long code = size == 1 ? first : first & (0xFFU >> (size + 1));
        for (std::size_t next = 1; next < size; ++next)
            code = code << 6 | (static_cast<unsigned char>(text[at++]) & 0x3FU);
        wide += static_cast<wchar_t>(code);
    }
    return wide;
}

} // namespace NQ

namespace VXLog
{

// Everything goes into one stream; the header's text member stays empty.
struct VXMessageBuffer::Stream {
    std::ostringstream out;
    std::string late; // text that a broken buffer keeps for the end
};

VXMessageBuffer::VXMessageBuffer() : stream_(new Stream) {}

VXMessageBuffer::~VXMessageBuffer() = default;

std::ostream& VXMessageBuffer::stream()
{
    return stream_->out;
}

VXMessageBuffer& VXMessageBuffer::operator<<(char const* text)
{
    return *this << std::string(text);
}

VXMessageBuffer& VXMessageBuffer::operator<<(char* text)
{
    return *this << std::string(text);
}

VXMessageBuffer& VXMessageBuffer::operator<<(std::string const& text)
{
    if (broken(Way::NumbersOvertakeText))
        stream_->late += text;
    else
        stream() << text;
    return *this;
}

std::ostream& VXMessageBuffer::operator<<(int number)
{
    return stream() << number;
}

std::ostream& VXMessageBuffer::operator<<(unsigned int number)
{
    return stream() << number;
}

std::string VXMessageBuffer::str(VXMessageBuffer&)
{
    return stream_->out.str() + stream_->late;
}

std::string VXMessageBuffer::str(std::ostream&)
{
    return stream_->out.str() + stream_->late;
}

namespace
{

/** The newest messages of both operations. */
class Journal
{
public:
    void keep(char const* extra, std::string const& message)
    {
        std::lock_guard<std::mutex> const guard(guard_);
        messages_.push_back(message);
        if (broken(Way::ExtraIsRead))
            messages_.back() += *extra;
        if (messages_.size() > 100)
            messages_.pop_front();
    }

private:
    std::mutex guard_;
    std::deque<std::string> messages_;
};

Journal& journal()
{
    static Journal one;
    return one;
}

} // namespace

void VXLogger::logLevelMessage(char const*, char const*, int, std::string const&, int, char* extra,
                               int, int, std::string const& message)
{
    journal().keep(extra, message);
}

void VXLogger::traceLevelMessage(char const*, char const*, int, std::string const&, int, char*, int,
                                 int, std::string const& message)
{
    journal().keep("", message);
}

} // namespace VXLog
