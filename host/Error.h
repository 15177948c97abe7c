#ifndef HOST_ERROR_H
#define HOST_ERROR_H

#include "host/Number.h"

#include <string>

namespace IC
{

/**
 * The outcome of a framework operation. Status 0 is success, anything else is failure.
 *
 * A value type, returned by value and never thrown.
 *
 * Contract: the plug-in makes room for objects of this class itself, so their size is fixed; see
 * OpenMI.h.
 */
class Error
{
public:
    enum StatusType : unsigned char { Success = 0, Failure = 1 };

    /**
     * @param status  0 for success
     * @param code    a detailed code for the host; a management interface leaves it 0 or empty
     * @param text    a reason for people to read, may be empty
     */
    Error(unsigned char status, Number const& code, std::string const& text);
    Error(Error const& other);
    Error& operator=(Error const& other);
    ~Error();

    unsigned char getStatus() const;

    /** The same status as an enumeration. */
    operator StatusType() const;

    /** A form for log messages: the status and the text, if any. */
    operator std::string() const;

    /** The reason alone, what a host reads; management interfaces do not call it. */
    std::string getText() const;

private:
    unsigned char status_;
    Number code_;
    std::string text_;
};

} // namespace IC

#endif
