#ifndef MIHOST_CLI_ACCELERATOR_H
#define MIHOST_CLI_ACCELERATOR_H

#include "mihost/cli/Json.h"

#include <string>
#include <vector>

namespace mihost
{

/**
 * From its making to the end of the process, commands are answered by the accelerator where it can.
 *
 * Its library is loaded only then, behind the program's own popen: a run without it is spared
 * everything that the library needs.
 */
class Accelerator
{
public:
    /** How often a command was asked for. */
    struct Row {
        std::string command;
        unsigned long answered; // in the process
        unsigned long run;
        std::string reason; // why it was last run; empty where it never was
    };

    /** @throws Failure where the library cannot be loaded */
    Accelerator();

    /** In the library's order, without the commands that were never asked for. */
    std::vector<Row> rows() const;

private:
    void* library_;
};

/** For people to read. */
std::string answersText(std::vector<Accelerator::Row> const& rows);

Json toJson(std::vector<Accelerator::Row> const& rows);

} // namespace mihost

#endif
