#ifndef MIHOST_CLI_OUTPUT_TREELAYOUT_H
#define MIHOST_CLI_OUTPUT_TREELAYOUT_H

#include "mihost/cli/output/Layout.h"

/** Trees as lines for people. */
namespace mihost
{

/** One node of a tree. */
struct Branch {
    std::size_t parent; // an index of the same list, smaller than its own; itself for none
    std::string name;   // printable and perhaps styled, never wrapped unless the room is too small
    std::string text;   // next to the name
    Grid details;       // below the text
};

std::vector<std::string> layOut(std::vector<Branch> const& branches, Room const& room);

} // namespace mihost

#endif
