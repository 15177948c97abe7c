#ifndef MIHOST_CLI_INPUT_FORMAT_H
#define MIHOST_CLI_INPUT_FORMAT_H

#include <string>
#include <string_view>
#include <vector>

namespace mihost
{

/** The form in which results are printed. */
enum class Format {
    TableText, // for people
    JsonText,  // a document on one line
    JsonLines, // each element of a list on its own line
    YamlText,
    CsvText,   // rows, below their headings
    BareValues // rows of bare values with tabs between them
};

/** As on the command line, in the order of the enumeration. */
std::vector<std::string> const& formatNames();

/** One of formatNames(). */
std::string const& nameOf(Format format);

/** @param name  one of formatNames() */
Format formatOf(std::string_view name);

/** Whether results are printed as documents with keys, for programs. */
bool isDocument(Format format);

/** Whether results are printed as rows without any layout, for programs. */
bool isRows(Format format);

} // namespace mihost

#endif
