/* startup_commands LIST: runs the commands of a file, one a line, one after the other through
 * popen, reads all that they print, and prints its own processor time. */

#include "own_time.h"

#include <string.h>

int main(int argc, char* argv[])
{
    char command[1024];
    char line[512];
    FILE* const list = argc == 2 ? fopen(argv[1], "r") : NULL;
    if (!list)
        return 1;
    while (fgets(command, sizeof command, list)) {
        command[strcspn(command, "\n")] = '\0';
        FILE* const output = popen(command, "r");
        if (!output)
            return 1;
        while (fgets(line, sizeof line, output))
            ;
        pclose(output);
    }
    fclose(list);
    printOwnTime();
    return 0;
}
