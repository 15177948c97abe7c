#include "util/text.h"

namespace NQ::TEXT
{

void replaceAfterFirst(char* s, char from, char to)
{
    if (*s == '\0')
        return;
    for (char* at = s + 1; *at != '\0'; ++at) {
        if (*at != from)
            continue;
        *at = to;
        if (to == '\0')
            return;
    }
}

} // namespace NQ::TEXT
