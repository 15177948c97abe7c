#include "tests/support/KernelModules.h"

#include "tests/support/Machine.h"

#include <cstdlib>
#include <cstring>
#include <elf.h>
#include <filesystem>
#include <numeric>
#include <stdexcept>
#include <sys/mount.h>
#include <sys/utsname.h>

namespace kernelModules
{

namespace
{

template <class Value> void put(std::string& bytes, Value const& value)
{
    bytes.append(reinterpret_cast<char const*>(&value), sizeof value);
}

std::string const& release()
{
    static std::string const name = [] {
        utsname system{};
        uname(&system);
        return std::string(system.release);
    }();
    return name;
}

void mountEmptyFolder(char const* path)
{
    if (mount("tmpfs", path, "tmpfs", 0, "mode=0755") != 0)
        throw std::runtime_error(std::string("cannot mount at ") + path);
}

void bind(char const* from, char const* to)
{
    std::filesystem::create_directory(to);
    if (mount(from, to, nullptr, MS_BIND | MS_REC, nullptr) != 0)
        throw std::runtime_error(std::string("cannot mount at ") + to);
}

std::string modulesLine(Loaded const& module)
{
    std::string const holders = std::accumulate(
        module.holders.begin(), module.holders.end(), std::string(),
        [](std::string const& all, std::string const& one) { return all + one + ','; });
    return module.name + ' ' + std::to_string(module.size) + ' ' + std::to_string(module.uses) +
           ' ' + (holders.empty() ? "-" : holders) + " Live 0x0000000000000000\n";
}

} // namespace

std::string folder()
{
    return "/lib/modules/" + release();
}

std::string file(std::vector<std::string> const& facts)
{
    std::string info;
    for (std::string const& fact : facts)
        info.append(fact).push_back('\0');
    std::string const names("\0.modinfo\0.shstrtab\0", 20);

    Elf64_Ehdr header{};
    std::memcpy(header.e_ident, ELFMAG, SELFMAG);
    header.e_ident[EI_CLASS] = ELFCLASS64;
    header.e_ident[EI_DATA] = ELFDATA2LSB;
    header.e_ident[EI_VERSION] = EV_CURRENT;
    header.e_type = ET_REL;
    header.e_machine = EM_X86_64;
    header.e_version = EV_CURRENT;
    header.e_ehsize = sizeof header;
    header.e_shentsize = sizeof(Elf64_Shdr);
    header.e_shnum = 3;
    header.e_shstrndx = 2;
    header.e_shoff = sizeof header + info.size() + names.size();

    Elf64_Shdr facts64{};
    facts64.sh_name = 1;
    facts64.sh_type = SHT_PROGBITS;
    facts64.sh_offset = sizeof header;
    facts64.sh_size = info.size();
    Elf64_Shdr names64{};
    names64.sh_name = 10;
    names64.sh_type = SHT_STRTAB;
    names64.sh_offset = sizeof header + info.size();
    names64.sh_size = names.size();

    std::string bytes;
    put(bytes, header);
    bytes += info + names;
    put(bytes, Elf64_Shdr{});
    put(bytes, facts64);
    put(bytes, names64);
    return bytes;
}

std::string signature(std::string const& signer)
{
    std::string const key = "\x01\x02\xab";
    std::string const sum(70, '\x5a');
    // Algorithm, hash, kind of name, lengths of signer and key, and that of the sum, big-endian.
    std::string const trailer{'\x01',
                              '\x04',
                              '\x01',
                              static_cast<char>(signer.size()),
                              static_cast<char>(key.size()),
                              0,
                              0,
                              0,
                              0,
                              0,
                              0,
                              static_cast<char>(sum.size())};
    return signer + key + sum + trailer + "~Module signature appended~\n";
}

void write(std::string const& fileName, std::string const& content)
{
    machine::write(folder() + '/' + fileName, content);
}

void install(std::vector<std::pair<std::string, std::vector<std::string>>> const& modules)
{
    for (auto const& [fileName, facts] : modules)
        write(fileName, file(facts));
    index();
}

void index()
{
    if (std::system("depmod 2>/dev/null") != 0)
        throw std::runtime_error("depmod failed");
}

void load(std::vector<Loaded> const& modules)
{
    // Neither /proc nor /sys accepts new files. The rest of /proc is linked.
    bind("/proc", "/run/processes");
    mountEmptyFolder("/proc");
    for (auto const& entry : std::filesystem::directory_iterator("/run/processes"))
        if (entry.path().filename() != "modules")
            std::filesystem::create_symlink(entry.path(), "/proc" / entry.path().filename());
    // In processes that start from now on, the leak checker could not read /proc.
    setenv("ASAN_OPTIONS", "detect_leaks=0", 1);
    mountEmptyFolder("/sys/module");
    std::string list;
    for (Loaded const& module : modules) {
        list += modulesLine(module);
        std::string const own = "/sys/module/" + module.name + '/';
        machine::write(own + "coresize", std::to_string(module.size) + '\n');
        machine::write(own + "refcnt", std::to_string(module.uses) + '\n');
        std::filesystem::create_directory(own + "holders");
        for (std::string const& holder : module.holders)
            std::filesystem::create_directory(own + "holders/" + holder);
    }
    machine::write("/proc/modules", list);
}

} // namespace kernelModules
