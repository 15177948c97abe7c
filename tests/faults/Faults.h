#ifndef TESTS_FAULTS_FAULTS_H
#define TESTS_FAULTS_FAULTS_H

#include <string>

/** Makes one system call fail, once, at a chosen moment. */
namespace faults
{

enum class Call {
    Popen,
    Fopen,
    Fgets,
    Sysinfo,
    Uname,
    Lckpwdf,
    ReadPasswd,
    ReadShadow,
    ReadGroup,
    Allocation,
    count
};

std::string nameOf(Call call);

/** From now on calls are counted from zero; the one numbered at fails. 0 lets all succeed. */
void arm(Call call, unsigned long at);

/** Ends counting. @return how many of the armed call were made */
unsigned long disarm();

/** Counts one call. @return whether it is the one to fail */
bool failsNow(Call call);

/** Puts the failing versions in front of the hooks that are set. */
void wrapHooks();

} // namespace faults

#endif
