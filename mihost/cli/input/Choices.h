#ifndef MIHOST_CLI_INPUT_CHOICES_H
#define MIHOST_CLI_INPUT_CHOICES_H

#include <CLI/App.hpp>
#include <map>
#include <string>
#include <vector>

namespace mihost
{

using Choices = std::vector<std::string>;

/** The options and arguments that take one of a few words. Help, check and completion use it. */
class ChoiceTable
{
public:
    /** Has the option refuse every other word, and shows the words in its help if they are few. */
    CLI::Option* restrict(CLI::Option* option, Choices const& choices);

    /** Null for an option that takes any word. */
    Choices const* find(CLI::Option const& option) const;

private:
    std::map<CLI::Option const*, Choices> table_;
};

} // namespace mihost

#endif
