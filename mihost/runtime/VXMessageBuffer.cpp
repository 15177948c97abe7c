#include "host/VXMessageBuffer.h"

#include <locale>
#include <ostream>
#include <streambuf>
#include <utility>

namespace VXLog
{

struct [[gnu::visibility("hidden")]] VXMessageBuffer::Stream
{
    class AppendToString : public std::streambuf
    {
    public:
        explicit AppendToString(std::string& text) : text_(text) {}

    protected:
        int_type overflow(int_type character) override
        {
            if (!traits_type::eq_int_type(character, traits_type::eof()))
                text_.push_back(traits_type::to_char_type(character));
            return traits_type::not_eof(character);
        }

        std::streamsize xsputn(char const* text, std::streamsize length) override
        {
            text_.append(text, static_cast<std::size_t>(length));
            return length;
        }

    private:
        std::string& text_;
    };

    explicit Stream(std::string & text) : buffer(text), out(&buffer)
    {
        out.imbue(std::locale::classic()); // plain digits, regardless of the host's locale
    }

    AppendToString buffer;
    std::ostream out;
};

VXMessageBuffer::VXMessageBuffer()
{
    constexpr std::size_t usualLength = 63;
    text_.reserve(usualLength); // one allocation for most messages
}

VXMessageBuffer::~VXMessageBuffer() = default;

VXMessageBuffer& VXMessageBuffer::operator<<(char const* text)
{
    text_ += text;
    return *this;
}

VXMessageBuffer& VXMessageBuffer::operator<<(char* text)
{
    text_ += text;
    return *this;
}

VXMessageBuffer& VXMessageBuffer::operator<<(std::string const& text)
{
    text_ += text;
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

std::string VXMessageBuffer::str(VXMessageBuffer& end)
{
    return std::move(end.text_);
}

std::string VXMessageBuffer::str(std::ostream& end)
{
    end.flush();
    return std::move(text_);
}

std::ostream& VXMessageBuffer::stream()
{
    if (!stream_)
        stream_ = std::make_unique<Stream>(text_);
    return stream_->out;
}

} // namespace VXLog
