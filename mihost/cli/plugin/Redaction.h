#ifndef MIHOST_CLI_PLUGIN_REDACTION_H
#define MIHOST_CLI_PLUGIN_REDACTION_H

#include "mihost/runtime/Runtime.h"

#include <string>
#include <vector>

namespace mihost
{

/** The text with each word that is one of the secrets replaced; words end at blanks and quotes. */
std::string withoutSecrets(std::string const& text, std::vector<std::string> const& secrets);

/** Passes log messages on without the secrets of the change that is being made. */
class RedactingSink : public LogSink
{
public:
    explicit RedactingSink(LogSink& to) : to_(to) {}

    /** Secrets are removed while it exists. */
    class Hiding
    {
    public:
        explicit Hiding(std::vector<std::string> const& secrets);
        ~Hiding();
        Hiding(Hiding const&) = delete;
        Hiding& operator=(Hiding const&) = delete;
    };

    void write(LogMessage const& message) override;

private:
    LogSink& to_;
};

} // namespace mihost

#endif
