#ifndef MIHOST_ACCEL_INDEXEDFILE_H
#define MIHOST_ACCEL_INDEXEDFILE_H

#include "mihost/accel/Answer.h"
#include "mihost/accel/LineIndex.h"
#include "mihost/accel/TextFile.h"

#include <functional>
#include <optional>
#include <string>

namespace miaccel
{

/**
 * Works an answer out from a file and its index, which stands for the very file. Gives nothing
 * where the file turns out to be no longer the indexed one.
 */
using Work = std::function<std::optional<Answer>(TextFile const& file, LineIndex const& index)>;

/**
 * Does the work on a file with its index brought up to date, again where the file changes under
 * it. Indexes are kept for the next time, those of a few files only.
 */
Answer withIndexedFile(std::string const& path, Work const& work);

} // namespace miaccel

#endif
