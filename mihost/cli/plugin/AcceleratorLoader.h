#ifndef MIHOST_CLI_PLUGIN_ACCELERATORLOADER_H
#define MIHOST_CLI_PLUGIN_ACCELERATORLOADER_H

#include "mihost/cli/output/Json.h"

#include <string>
#include <vector>

namespace mihost
{

/**
 * Loads the accelerator, which answers commands, if it can, until the process ends. If its library
 * is missing, every command is run.
 */
class Accelerator
{
public:
    /** How often a command was used. */
    struct Row {
        std::string command;
        unsigned long answered; // in the process
        unsigned long run;
        std::string reason; // why it was last run; empty if it never was
    };

    Accelerator();

    /** In the library's order, without the commands that were never used. */
    std::vector<Row> rows() const;

private:
    void* library_;
    std::string problem_; // why it could not be loaded
};

/** For people to read. */
std::string answersText(std::vector<Accelerator::Row> const& rows);

Json toJson(std::vector<Accelerator::Row> const& rows);

} // namespace mihost

#endif
