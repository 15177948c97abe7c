#ifndef TESTS_SUPPORT_MACHINE_H
#define TESTS_SUPPORT_MACHINE_H

#include "tests/support/Program.h"

#include <string>
#include <sys/types.h>
#include <vector>

/**
 * The machine that a test runs on: a new copy of this one, which it may change.
 *
 * For tests that run in the sandbox; outside it, functions that change something throw.
 */
namespace machine
{

/**
 * Puts the files of tests/machines/NAME over those of the copy, all owned by root. Release files
 * that are not among them are removed; everything else of this machine stays.
 */
void lay(std::string const& name);

/** Records every command line given to /bin/sh from now on; the real shell then runs it. */
void recordShell();

/** Records every call of one program, such as "/usr/sbin/useradd", from now on, and runs it. */
void record(std::string const& program);

/** @return the command lines given to the shell since recordShell, in order, unchanged */
std::vector<std::string> ran();

/** @return the arguments of each call of one recorded program, in order, without its name */
std::vector<std::vector<std::string>> calls(std::string const& program);

/** Forgets what was recorded so far. */
void forget();

/** Replaces a file, and makes the directories that lead to it. */
void write(std::string const& path, std::string const& text, mode_t mode = 0644);

/** Replaces a program by a shell script, given without its first line. */
void fake(std::string const& program, std::string const& script);

/** Makes ids from 1000 to 60000 those of ordinary accounts and groups. */
void writeIdRanges();

/** Runs a command line. @throws std::runtime_error unless it succeeds */
void run(std::string const& line);

/** Runs mihost as a user without privileges. */
Outcome mihostRunAsUser(std::vector<std::string> arguments, std::string const& input = "");

/** Removes a file if it exists. */
void remove(std::string const& path);

std::string read(std::string const& path);

/**
 * @return the fields of the record with this first field in a file whose fields are separated by
 *         colons: /etc/passwd, /etc/shadow or /etc/group; empty if there is none
 */
std::vector<std::string> entry(std::string const& file, std::string const& name);

} // namespace machine

#endif
