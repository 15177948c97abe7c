#ifndef TESTS_INTERPOSE_HOST_H
#define TESTS_INTERPOSE_HOST_H

#include "host/MutableNode.h"
#include "host/Mutex.h"
#include "host/VXMessageBuffer.h"
#include "tests/interpose/Call.h"

#include <ostream>
#include <string>

/** The host's operations that the plug-in calls, replaced in the test program. */
namespace host
{

using interpose::Call;

struct Hooks {
    Call<IC::Error(IC::MutableNode* node, unsigned int const& status)> setStatus;
    Call<IC::Error(IC::MutableNode* node, std::string const& description)> setDescription;
    Call<IC::Error(IC::MutableNode* node, unsigned int const& id, IC::PropertyValue const& value)>
        setProperty;
    Call<int(NQ::Mutex* mutex, unsigned long timeout)> lock{"lock", -1};
    Call<int(NQ::Mutex* mutex)> unlock{"unlock", -1};
    Call<std::wstring(std::string const& text)> widen{"make_wstring"};
    Call<std::string(std::wstring const& text)> narrow{"make_string of a wide text"};
    Call<std::string(char const* text)> makeText{"make_string of a C string"};
    Call<std::string(VXLog::VXMessageBuffer* buffer, VXLog::VXMessageBuffer& end)> textOfBuffer{
        "str of a buffer"};
    Call<std::string(VXLog::VXMessageBuffer* buffer, std::ostream& end)> textOfStream{
        "str of a stream"};

    Hooks();
};

Hooks& hooks();

} // namespace host

#endif
