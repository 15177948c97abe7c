#ifndef MIHOST_SANDBOX_LAYERFILES_H
#define MIHOST_SANDBOX_LAYERFILES_H

#include "mihost/sandbox/Descriptor.h"

#include <functional>
#include <optional>
#include <string>
#include <sys/stat.h>

/**
 * Files below an open directory; their paths begin with a slash and are relative to it. All throw
 * std::system_error for unreadable files.
 */
namespace mihost::layerFiles
{

/** @return nothing if the file does not exist */
std::optional<struct stat> statusOf(Descriptor const& root, std::string const& path);

/** @return the target of a symbolic link */
std::string targetOf(Descriptor const& root, std::string const& path);

/** @return nothing for a file that contains a NUL byte or is longer than 8 MiB */
std::optional<std::string> textOf(Descriptor const& root, std::string const& path);

/** Whether the file at the path holds the same bytes below both directories. */
bool sameContent(Descriptor const& root, Descriptor const& otherRoot, std::string const& path);

/** Whether an overlay's directory hides the one below it. */
bool isOpaque(Descriptor const& root, std::string const& path);

/** Whether it is an overlay's mark that nothing is there. */
bool isWhiteout(struct stat const& status);

using Visit = std::function<void(std::string const& path, struct stat const& status)>;

/** Visits everything below a path, a directory before its contents; "" is the open directory. */
void walk(Descriptor const& root, std::string const& path, Visit const& visit);

} // namespace mihost::layerFiles

#endif
