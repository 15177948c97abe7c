#ifndef TESTS_SUPPORT_KERNELMODULES_H
#define TESTS_SUPPORT_KERNELMODULES_H

#include <string>
#include <utility>
#include <vector>

/** Kernel modules of our own making, for the copy of the machine that a test runs in. */
namespace kernelModules
{

/** The folder where the running kernel's modules are looked for. */
std::string folder();

/**
 * A module's file as compilers make it, with nothing in it but its facts.
 *
 * @param facts  "key=value" each
 */
std::string file(std::vector<std::string> const& facts);

/** What is put at a module's end when it is signed; the signer may hold any bytes. */
std::string signature(std::string const& signer);

/** Puts a module into the folder. */
void write(std::string const& fileName, std::string const& content);

/** Puts modules of these file names and facts into the folder, and indexes it. */
void install(std::vector<std::pair<std::string, std::vector<std::string>>> const& modules);

/** Has depmod index what is in the folder. */
void index();

/** A loaded module, as the kernel describes it. */
struct Loaded {
    std::string name;
    long size;
    int uses;
    std::vector<std::string> holders;
};

/** From now on these modules are loaded, for all that reads /proc/modules and /sys/module. */
void load(std::vector<Loaded> const& modules);

} // namespace kernelModules

#endif
