#ifndef MIHOST_HOSTCHECK_TAP_H
#define MIHOST_HOSTCHECK_TAP_H

#include <cstdio>
#include <memory>
#include <string>

namespace hostcheck
{

/**
 * The findings as Test Anything Protocol, if the environment variable MIHOSTCHECK_TAP names a file,
 * or "-" for standard output. Every line is written at once: a crash leaves the last one.
 */
class Tap
{
public:
    explicit Tap(std::size_t count);

    /** Whether the requested file could be opened, or none was requested. */
    bool ready() const
    {
        return ready_;
    }

    void running(std::string const& name);
    void result(std::size_t number, std::string const& name, std::string const& explanation);
    void bailOut(std::string const& reason);

private:
    struct Close {
        void operator()(std::FILE* file) const
        {
            if (file != stdout)
                std::fclose(file);
        }
    };

    void line(std::string const& text);

    bool ready_ = true;
    std::unique_ptr<std::FILE, Close> out_; // null if not requested
};

} // namespace hostcheck

#endif
