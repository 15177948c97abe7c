#include "mihost/cli/input/Choices.h"

#include "mihost/cli/input/Suggestion.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>

namespace mihost
{

CLI::Option* ChoiceTable::restrict(CLI::Option* option, Choices const& choices)
{
    constexpr std::size_t longestForm = 40; // longer names leave no room for the meaning
    table_[option] = choices;
    std::string const form = fmt::format("{}", fmt::join(choices, "|"));
    option->type_name(form.size() <= longestForm ? form : "");
    return option->check([choices](std::string const& word) -> std::string {
        if (std::find(choices.begin(), choices.end(), word) != choices.end())
            return "";
        return fmt::format("unknown value '{}' ({})", word, suggestion(word, choices, "use"));
    });
}

Choices const* ChoiceTable::find(CLI::Option const& option) const
{
    auto const found = table_.find(&option);
    return found == table_.end() ? nullptr : &found->second;
}

} // namespace mihost
