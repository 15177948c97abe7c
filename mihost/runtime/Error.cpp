#include "host/Error.h"

namespace IC
{

Error::Error(unsigned char status, Number const& code, std::string const& text)
    : status_(status), code_(code), text_(text)
{
}

Error::Error(Error const& other) = default;

Error& Error::operator=(Error const& other) = default;

Error::~Error() = default;

unsigned char Error::getStatus() const
{
    return status_;
}

Error::operator StatusType() const
{
    return static_cast<StatusType>(status_);
}

Error::operator std::string() const
{
    std::string form = "status " + std::to_string(static_cast<unsigned int>(status_));
    if (!text_.empty())
        form += ": " + text_;
    return form;
}

std::string Error::getText() const
{
    return text_;
}

} // namespace IC
