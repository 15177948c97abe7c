// Replaces a program: records how it was called, then becomes the real one, which was
// renamed to its name and ".real".

#include <climits>
#include <cstdio>
#include <fcntl.h>
#include <string>
#include <unistd.h>

int main(int argc, char* argv[])
{
    char self[PATH_MAX] = "";
    if (readlink("/proc/self/exe", self, sizeof self - 1) < 0)
        return 127;

    // The program, the number of arguments and the arguments, a NUL after each; written at once,
    // so that programs that run at the same time do not mix their records.
    std::string note = self;
    note.push_back('\0');
    note += std::to_string(argc);
    note.push_back('\0');
    for (int i = 0; i < argc; ++i) {
        note += argv[i];
        note.push_back('\0');
    }
    int const notes = open("/run/recorded", O_WRONLY | O_APPEND | O_CLOEXEC);
    if (notes < 0 || write(notes, note.data(), note.size()) < 0) {
        std::perror("recorder");
        return 127;
    }

    std::string const real = std::string(self) + ".real";
    execv(real.c_str(), argv);
    std::perror(real.c_str());
    return 127;
}
