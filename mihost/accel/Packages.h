#ifndef MIHOST_ACCEL_PACKAGES_H
#define MIHOST_ACCEL_PACKAGES_H

#include <string>

namespace miaccel
{

/**
 * Whether a file holds what its Debian package installed.
 *
 * @param path      with no links in it
 * @param package   name of the package that the file must come from
 * @param versions  what the installed version must begin with, blanks between several; empty for
 * any
 */
bool isFromPackage(std::string const& path, std::string const& package,
                   std::string const& versions);

/** What dpkg's status file says of an installed package; empty where it says nothing. */
std::string fieldIn(std::string const& status, std::string const& package, std::string const& name);

/** The digest that a package's list has for a path, on a merged /usr or not; empty for none. */
std::string digestIn(std::string const& list, std::string const& path);

} // namespace miaccel

#endif
