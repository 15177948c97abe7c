#ifndef TESTS_SUPPORT_MACHINE_H
#define TESTS_SUPPORT_MACHINE_H

#include <string>
#include <sys/types.h>
#include <vector>

/**
 * The machine that a test finds itself on: a fresh copy of this one, to be changed at will.
 *
 * For tests that run in the sandbox; whatever changes something throws elsewhere.
 */
namespace machine
{

/**
 * Lays the files of tests/machines/NAME over the copy, all owned by root. Release files that are
 * not among them are removed; everything else of this machine stays.
 */
void lay(std::string const& name);

/** Notes every command line given to /bin/sh from now on; each is then run by the real shell. */
void recordShell();

/** Notes every call of one program from now on, such as "/usr/sbin/useradd", and runs it. */
void record(std::string const& program);

/** The command lines given to the shell since recordShell, in order, exactly. */
std::vector<std::string> ran();

/** The argument lists of one recorded program's calls, in order, without its own name. */
std::vector<std::vector<std::string>> calls(std::string const& program);

/** Forgets what was recorded so far. */
void forget();

/** Replaces a file, and makes the folders that lead to it. */
void write(std::string const& path, std::string const& text, mode_t mode = 0644);

/** Replaces a program by a shell script; what is given is all but the first line. */
void fake(std::string const& program, std::string const& script);

/** Removes a file; one that is not there is fine. */
void remove(std::string const& path);

std::string read(std::string const& path);

/**
 * One record of a file of records whose fields are separated by colons: /etc/passwd, /etc/shadow,
 * /etc/group. Empty where no record has this first field.
 */
std::vector<std::string> entry(std::string const& file, std::string const& name);

} // namespace machine

#endif
