#include "mihost/cli/system/DrainedPipe.h"

#include <array>
#include <csignal>
#include <poll.h>
#include <sys/eventfd.h>
#include <sys/ioctl.h>
#include <utility>

namespace mihost
{

namespace
{

/** Starts a thread that gets no signals: they are the main thread's. */
template <class Function> std::thread startWithoutSignals(Function function)
{
    sigset_t all;
    sigset_t before;
    sigfillset(&all);
    pthread_sigmask(SIG_SETMASK, &all, &before);
    try {
        std::thread thread(function);
        pthread_sigmask(SIG_SETMASK, &before, nullptr);
        return thread;
    } catch (...) {
        pthread_sigmask(SIG_SETMASK, &before, nullptr);
        throw;
    }
}

} // namespace

DrainedPipe::DrainedPipe() : stop_(check(eventfd(0, EFD_CLOEXEC), "cannot create an event"))
{
    thread_ = startWithoutSignals([this] { drain(); });
}

DrainedPipe::~DrainedPipe()
{
    eventfd_write(stop_.get(), 1);
    thread_.join();
}

std::string DrainedPipe::take()
{
    std::lock_guard<std::mutex> const lock(mutex_);
    readWhatIsThere();
    return std::exchange(text_, {}).text();
}

void DrainedPipe::drain()
{
    std::array<pollfd, 2> watched{pollfd{pipe_.readEnd.get(), POLLIN, 0},
                                  pollfd{stop_.get(), POLLIN, 0}};
    while (watched[1].revents == 0) {
        if (poll(watched.data(), watched.size(), -1) < 0)
            continue; // stopped and continued
        std::lock_guard<std::mutex> const lock(mutex_);
        readWhatIsThere();
    }
}

void DrainedPipe::readWhatIsThere()
{
    int length = 0; // not to the end: a command left running may write for ever
    if (ioctl(pipe_.readEnd.get(), FIONREAD, &length) != 0 || length == 0)
        return;
    std::string block(static_cast<std::size_t>(length), '\0');
    ssize_t const got = read(pipe_.readEnd.get(), block.data(), block.size());
    if (got > 0)
        text_.append({block.data(), static_cast<std::size_t>(got)});
}

} // namespace mihost
