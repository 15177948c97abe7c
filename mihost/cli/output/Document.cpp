#include "mihost/cli/output/Document.h"

namespace mihost
{

namespace
{

/** Each element of a list on its own line. */
std::string jsonLines(Json const& document)
{
    if (!document.is_array())
        return document.dump() + '\n';
    std::string text;
    for (Json const& element : document)
        text += element.dump() + '\n';
    return text;
}

} // namespace

std::string documentText(Json const& document, Format format)
{
    if (format == Format::YamlText)
        return yamlText(document);
    return format == Format::JsonLines ? jsonLines(document) : document.dump() + '\n';
}

} // namespace mihost
