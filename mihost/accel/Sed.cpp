#include "mihost/accel/Sed.h"

#include "mihost/accel/IndexedFile.h"

namespace miaccel
{

namespace
{

constexpr std::uint64_t longestLine = std::uint64_t{16} * 1024 * kibibyte;

std::optional<Answer> lineText(TextFile const& file, LineIndex const& index, std::uint64_t line)
{
    std::optional<Extent> const extent = index.find(file, line);
    if (!extent)
        return std::nullopt;
    if (extent->length > longestLine)
        return Answer::none("the line is too long to be held");
    std::string text(extent->length, '\0');
    if (!file.read(text.data(), text.size(), extent->offset))
        return std::nullopt;
    return Answer::with(std::move(text));
}

} // namespace

Answer sed(std::string const& path, std::uint64_t line)
{
    return withIndexedFile(path, [line](TextFile const& file, LineIndex const& index) {
        return lineText(file, index, line);
    });
}

} // namespace miaccel
