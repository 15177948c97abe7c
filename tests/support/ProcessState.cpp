// Each test begins with the state of the process that the first one began with, so that tests do
// not depend on their order.

#include "tests/interpose/Call.h"

#include <clocale>
#include <ctime>
#include <dlfcn.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

mode_t currentMask()
{
    mode_t const mask = umask(0);
    umask(mask);
    return mask;
}

std::vector<std::string> currentEnvironment()
{
    std::vector<std::string> entries;
    for (char** entry = environ; *entry; ++entry)
        entries.emplace_back(*entry);
    return entries;
}

/** Contract: read once per process. @return null if the program does not contain the plug-in */
void** idRanges()
{
    return static_cast<void**>(dlsym(RTLD_DEFAULT, "_ZN2NQ8minMaxId9pinstanceE"));
}

class ProcessState : public testing::EmptyTestEventListener
{
public:
    void OnTestStart(testing::TestInfo const&) override
    {
        environment_ = currentEnvironment();
        folder_ = std::filesystem::current_path();
        locale_ = std::setlocale(LC_ALL, nullptr);
        mask_ = currentMask();
        if (void** const ranges = idRanges())
            ranges_ = *ranges;
    }

    void OnTestEnd(testing::TestInfo const&) override
    {
        restoreEnvironment();
        std::filesystem::current_path(folder_);
        std::setlocale(LC_ALL, locale_.c_str());
        umask(mask_);
        interpose::resetAll();
        forgetIdRanges();
    }

private:
    void restoreEnvironment() const
    {
        clearenv();
        for (std::string const& entry : environment_) {
            std::size_t const end = entry.find('=');
            setenv(entry.substr(0, end).c_str(), entry.substr(end + 1).c_str(), 1);
        }
        tzset();
    }

    void forgetIdRanges() const
    {
        void** const ranges = idRanges();
        if (!ranges || *ranges == ranges_)
            return;
        operator delete(*ranges); // its destructor is trivial
        *ranges = ranges_;
    }

    std::vector<std::string> environment_;
    std::filesystem::path folder_;
    std::string locale_;
    mode_t mask_ = 0;
    void* ranges_ = nullptr;
};

bool const registered = [] {
    testing::UnitTest::GetInstance()->listeners().Append(new ProcessState);
    return true;
}();

} // namespace
