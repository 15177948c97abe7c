#include "mihost/cli/system/StandardFiles.h"

#include <fcntl.h>
#include <initializer_list>
#include <unistd.h>

namespace mihost
{

bool fillMissingStandardFiles()
{
    for (int const file : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        if (fcntl(file, F_GETFD) >= 0)
            continue;
        // Deliberately opened for the other direction, so that writes to a missing output fail.
        int const mode = file == STDIN_FILENO ? O_WRONLY : O_RDONLY;
        if (open("/dev/null", mode) != file)
            return false;
    }
    return true;
}

} // namespace mihost
