#ifndef TESTS_SUPPORT_KERNELMODULES_H
#define TESTS_SUPPORT_KERNELMODULES_H

#include <string>
#include <utility>
#include <vector>

/** Invented kernel modules, for the copy of the machine that a test runs in. */
namespace kernelModules
{

/** @return the directory where programs look for the running kernel's modules */
std::string folder();

/**
 * Makes a module's file as compilers do, with nothing in it but its facts.
 *
 * @param facts  "key=value" each
 */
std::string file(std::vector<std::string> const& facts);

/** @return what signing appends to a module; the signer may contain any bytes */
std::string signature(std::string const& signer);

/** Puts a module into the directory. */
void write(std::string const& fileName, std::string const& content);

/** Puts modules of these file names and facts into the directory, and indexes it. */
void install(std::vector<std::pair<std::string, std::vector<std::string>>> const& modules);

/** Runs depmod to index the directory. */
void index();

/** A loaded module, as the kernel describes it. */
struct Loaded {
    std::string name;
    long size;
    int uses;
    std::vector<std::string> holders;
};

/** Makes /proc/modules and /sys/module show these modules as loaded from now on. */
void load(std::vector<Loaded> const& modules);

} // namespace kernelModules

#endif
