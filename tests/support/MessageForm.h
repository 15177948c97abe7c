#ifndef TESTS_SUPPORT_MESSAGEFORM_H
#define TESTS_SUPPORT_MESSAGEFORM_H

#include <optional>
#include <string>

/**
 * What is wrong with the form of a message of mihost: it is short, begins in lower case, ends
 * without a full stop, and says in parentheses what to do.
 *
 * @param message  without "mihost: "; texts in quotation marks may have any form and length
 */
std::optional<std::string> flawOf(std::string const& message);

/** The same for each line that a program wrote to its standard error and that is such a message. */
std::optional<std::string> flawOfMessages(std::string const& standardError);

#endif
