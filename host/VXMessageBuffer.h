#ifndef HOST_VXMESSAGEBUFFER_H
#define HOST_VXMESSAGEBUFFER_H

#include <iosfwd>
#include <memory>
#include <string>

namespace VXLog
{

/**
 * Assembles one log message. Not reused: each message takes a new buffer.
 *
 * Writing text returns the buffer, so more of its operators can follow; writing a number returns a
 * stream on the same buffer, so anything that a stream accepts can follow.
 *
 * Contract: the plug-in makes room for objects of this class itself, so their size is fixed; see
 * OpenMI.h.
 */
class VXMessageBuffer
{
public:
    VXMessageBuffer();
    ~VXMessageBuffer();

    VXMessageBuffer& operator<<(char const* text);
    VXMessageBuffer& operator<<(char* text);
    VXMessageBuffer& operator<<(std::string const& text);
    std::ostream& operator<<(int number);
    std::ostream& operator<<(unsigned int number);

    /**
     * The finished message, taken out of the buffer; the argument is what the chain of operators
     * returned.
     */
    std::string str(VXMessageBuffer& end);
    std::string str(std::ostream& end);

private:
    VXMessageBuffer(VXMessageBuffer const&) = delete;
    VXMessageBuffer& operator=(VXMessageBuffer const&) = delete;

    std::ostream& stream();

    std::string text_;
    struct Stream;
    std::unique_ptr<Stream> stream_; // made by the first number
};

} // namespace VXLog

#endif
