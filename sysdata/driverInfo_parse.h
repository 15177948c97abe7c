#ifndef SYSDATA_DRIVERINFO_PARSE_H
#define SYSDATA_DRIVERINFO_PARSE_H

#include "util/internal.h"

#include <cstddef>

namespace NQ
{

class driverInfo;

/** What the lines that lsmod and modinfo print mean. Not part of the plug-in's interface. */
namespace MI_INTERNAL driverLines
{

/** Room for one line and its NUL. A longer line is read in pieces, each as a line. */
constexpr std::size_t lineSize = 512;

/**
 * The first word of a line of lsmod.
 *
 * @return false for a blank line
 */
bool findModule(char const* line, char (&module)[lineSize]);

/** Contract: treats every module whose name begins with "Module" as the header, too. */
bool isHeader(char const* module);

/** How often modinfo gave a fact of one module. */
struct Seen {
    unsigned int versions = 0;
    unsigned int descriptions = 0;
};

/**
 * Takes a version or description over from one line of modinfo; other lines say nothing.
 *
 * @param line  changed in place
 * @return false for a version or description that no space follows; nothing is taken over then
 */
bool takeFact(char* line, driverInfo& driver, Seen& seen);

/** Completes a record once all lines of modinfo are taken in. */
void complete(driverInfo& driver, Seen const& seen, char const* module);

} // namespace driverLines

} // namespace NQ

#endif
