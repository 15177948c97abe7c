#ifndef SYSDATA_DRIVERINFO_PARSE_H
#define SYSDATA_DRIVERINFO_PARSE_H

#include "util/internal.h"

#include <cstddef>

namespace NQ
{

class driverInfo;

/** Parsers for the lines of lsmod and modinfo. Not part of the plug-in's interface. */
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

/** Which facts the output of modinfo for one module had so far. */
struct Seen {
    bool version = false;
    bool description = false;
};

/**
 * Sets the version or the description from a line of modinfo, in place of an earlier one; ignores
 * other lines.
 *
 * @param line  changed in place
 * @return false for a version or description without a space after it; the driver is unchanged
 */
bool takeFact(char* line, driverInfo& driver, Seen& seen);

/** Completes a record after the last line of modinfo. */
void complete(driverInfo& driver, Seen const& seen, char const* module);

} // namespace driverLines

} // namespace NQ

#endif
