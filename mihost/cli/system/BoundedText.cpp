#include "mihost/cli/system/BoundedText.h"

#include <fmt/format.h>

namespace mihost
{

void BoundedText::append(std::string_view part)
{
    std::string_view const fitting = part.substr(0, limit - kept_.size());
    kept_ += fitting;
    dropped_ += part.size() - fitting.size();
}

std::string BoundedText::text() const
{
    if (dropped_ == 0)
        return kept_;
    bool const endsLine = !kept_.empty() && kept_.back() == '\n';
    return fmt::format("{}{}... ({} more bytes)\n", kept_, endsLine ? "" : "\n", dropped_);
}

} // namespace mihost
