#include "mihost/accel/Wc.h"

#include "mihost/accel/IndexedFile.h"

namespace miaccel
{

Answer wc(std::string const& path)
{
    return withIndexedFile(path, [&path](TextFile const&, LineIndex const& index) {
        return Answer::with(std::to_string(index.lineEnds()) + ' ' + path + '\n');
    });
}

} // namespace miaccel
