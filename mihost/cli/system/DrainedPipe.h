#ifndef MIHOST_CLI_SYSTEM_DRAINEDPIPE_H
#define MIHOST_CLI_SYSTEM_DRAINEDPIPE_H

#include "mihost/cli/system/BoundedText.h"
#include "mihost/sandbox/Pipe.h"

#include <mutex>
#include <string>
#include <thread>

namespace mihost
{

/** A pipe that never fills up: a thread reads everything and keeps the beginning. */
class DrainedPipe
{
public:
    /** @throws std::system_error without a pipe or a thread */
    DrainedPipe();
    ~DrainedPipe();
    DrainedPipe(DrainedPipe const&) = delete;
    DrainedPipe& operator=(DrainedPipe const&) = delete;

    int writeEnd() const
    {
        return pipe_.writeEnd.get();
    }

    /** The beginning of what was written since the last call. */
    std::string take();

private:
    void drain();
    void readWhatIsThere();

    Pipe pipe_;
    Descriptor stop_;
    std::mutex mutex_; // of reading and of the text
    BoundedText text_;
    std::thread thread_;
};

} // namespace mihost

#endif
