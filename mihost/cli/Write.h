#ifndef MIHOST_CLI_WRITE_H
#define MIHOST_CLI_WRITE_H

#include "mihost/cli/Session.h"

#include <string>

namespace mihost
{

/** One write of a property, to be carried out. */
struct Write {
    IC::MutableNode& node;
    unsigned int property;
    IC::PropertyValue value;
    std::string secret; // never shown, wherever it turns up; empty for none
};

/**
 * Carries the write out and tells what came of it. In a sandbox that includes the commands that
 * were run, their output, and the lines that changed in the account files.
 *
 * @throws Failure (PluginRefused) where the plug-in answers with a non-zero status
 */
void carryOut(Session& session, Write const& write);

/** The text with each word that is the secret replaced; words end at blanks and quotes. */
std::string withoutSecret(std::string const& text, std::string const& secret);

} // namespace mihost

#endif
