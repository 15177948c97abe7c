#include "mihost/hostcheck/Tap.h"

#include <cstdlib>

namespace hostcheck
{

Tap::Tap(std::size_t count)
{
    char const* const wanted = std::getenv("MIHOSTCHECK_TAP");
    if (!wanted || !*wanted)
        return;
    out_.reset(std::string(wanted) == "-" ? stdout : std::fopen(wanted, "we"));
    ready_ = out_ != nullptr;
    line("TAP version 14");
    line("1.." + std::to_string(count));
}

void Tap::running(std::string const& name)
{
    line("# running " + name);
}

void Tap::result(std::size_t number, std::string const& name, std::string const& explanation)
{
    line((explanation.empty() ? "ok " : "not ok ") + std::to_string(number) + " - " + name);
    if (!explanation.empty())
        line("# " + explanation);
}

void Tap::bailOut(std::string const& reason)
{
    line("Bail out! " + reason);
}

void Tap::line(std::string const& text)
{
    if (!out_)
        return;
    std::fprintf(out_.get(), "%s\n", text.c_str());
    std::fflush(out_.get());
}

} // namespace hostcheck
