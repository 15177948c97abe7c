#ifndef MIHOST_HOSTCHECK_CHECK_H
#define MIHOST_HOSTCHECK_CHECK_H

#include <initializer_list>
#include <string>
#include <vector>

namespace hostcheck
{

/** One requirement of a host's framework. */
struct Check {
    char const* operation; // as declared in host/
    char const* promise;   // what it does
    std::string (*run)();  // empty, or what it did instead
};

using Checks = std::vector<Check>;

// One table for each subject. A table relies on the promises of those above it.

Checks layoutChecks(); // by-value classes and base classes in memory
Checks slotChecks();   // virtual operations, type information, protected members
Checks valueChecks();  // Number, EnumValue, Error, Alert
Checks propertyValueChecks();
Checks textChecks(); // make_string, make_wstring
Checks logChecks();  // VXMessageBuffer, VXLogger
Checks lockChecks(); // Mutex
Checks nodeChecks();
Checks interfaceChecks(); // ManagementInterface: the node list and the load callback

/** The first that is not empty; empty if all are. */
std::string firstOf(std::initializer_list<std::string> explanations);

/** Empty if both are equal, else the found and the expected value. */
std::string equal(char const* what, long long found, long long expected);
std::string equal(char const* what, std::string const& found, std::string const& expected);

/** Empty if it is as it should be, else the explanation. */
std::string holds(bool right, std::string const& explanation);

/** Texts of all kinds: empty, long, with every byte, with percent signs. */
std::vector<std::string> const& oddTexts();

} // namespace hostcheck

#endif
