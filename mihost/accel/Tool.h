#ifndef MIHOST_ACCEL_TOOL_H
#define MIHOST_ACCEL_TOOL_H

namespace miaccel
{

/** A program or library whose output is known. */
struct Tool {
    char const* path;     // as installed, with no links in it
    char const* package;  // whose file it is
    char const* versions; // what the package's version must begin with: words; empty for any
};

/**
 * Whether the tool's file holds what its package installed. What was found out about a file is kept
 * until the file changes.
 */
bool isGenuine(Tool const& tool);

/** Whether running the path runs the genuine tool. */
bool leadsTo(char const* path, Tool const& tool);

} // namespace miaccel

#endif
