#ifndef MIHOST_CLI_INPUT_OPTIONS_H
#define MIHOST_CLI_INPUT_OPTIONS_H

#include "mihost/cli/input/Format.h"
#include "mihost/cli/system/Colours.h"

#include <string>

namespace mihost
{

/** The options before the command, common to all commands. */
struct Options {
    std::string host;    // the host for ssh; empty for this machine
    std::string plugin;  // empty for the one that was installed with this program
    std::string trace;   // empty for none, "-" for standard error
    std::string overlay; // a folder to lay over the sandbox; empty for none
    bool sandbox = false;
    Format format = Format::TableText;
    Colours colours = Colours::Auto;
    bool noHeaders = false; // of tables and CSV
    bool full = false;      // nothing is wrapped to fit the terminal
    bool noPager = false;
    bool quiet = false; // no warnings and no progress
    bool showSecrets = false;
    bool yes = false; // do without asking
    bool timing = false;
    unsigned int lockTimeout = 60; // seconds to wait for another mihost that changes the machine
    bool noAccel = false;          // every command of the plug-in is run
};

} // namespace mihost

#endif
