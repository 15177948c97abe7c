#ifndef SYSDATA_OSINFO_LINUX_H
#define SYSDATA_OSINFO_LINUX_H

#include "sysdata/ParamInfo.h"

#include <string>
#include <vector>

namespace NQ
{

/** Logger category of this source unit. */
extern std::string loggerOsInfo;

/**
 * The facts about the running operating system, and its administration.
 *
 * Holds nothing and caches nothing: each call reads the system. A fact getter writes its
 * result into its argument and returns true for success.
 */
class OsInfo
{
public:
    OsInfo();
    ~OsInfo();

    // Fixed values; always true.
    bool getDistributed(bool& out);
    bool getProcessMaxNumber(unsigned int& out);
    bool getProcessMaxMemory(unsigned int& out);
    bool getLicensedUserCount(unsigned int& out);
    bool getVirtualMemorySize(unsigned int& out);
    bool getVirtualMemoryFree(unsigned int& out);
    bool getOSCreateUser(std::string& out);

    /**
     * Memory in KiB, from sysinfo; 0 if sysinfo fails. Always true.
     *
     * Contract: with a memory unit of 0 or of 2 to 1023 bytes nothing is written, so initialise
     * out.
     */
    bool getPhysicalMemorySize(unsigned int& out);
    bool getPhysicalMemoryFree(unsigned int& out);

    /** Swap in the kernel's memory units, not scaled; 0 if sysinfo fails. Always true. */
    bool getSwapFileSize(unsigned int& out);
    bool getSwapFileFree(unsigned int& out);

    /** Swap in use, in the kernel's memory units; 0 if sysinfo fails. Always true. */
    bool getSwapFileSizeStored(unsigned int& out);

    /** Number of current processes, from sysinfo; 0 if it fails. Always true. */
    bool getProcessCount(unsigned int& out);

    /** Seconds since 1970, from the clock and sysinfo's uptime. */
    bool getLastBootTime(long& out);

    /** Number of ordinary accounts and of those with UID 0 in /etc/passwd. Always true. */
    bool getUserCount(unsigned int& out);

    /** Last status change of the distribution's release file, seconds since 1970. Always true. */
    bool getInstallDate(long& out);

    /** First line of the first release file there is, else "Linux". Always true. */
    bool getOSName(std::string& out);

    /** First line of the file, as it is. */
    bool getOSReleaseName(std::string path, std::string& out);

    /** The distribution's version; at most 9 characters if read by a command. */
    bool getOSVersion(std::string& out);

    /** The values in lines 2 and 3 of a release file of key = value lines, joined by a dot. */
    bool getKestoVersion(std::string path, std::string& out);

    /** The language of LANG, else of LC_CTYPE, such as "en-US". Always true. */
    bool getLanguageEdition(std::string& out);

    /** The code set of LANG, else that of the process's locale, such as "UTF-8". Always true. */
    bool getCodeSet(std::string& out);

    /**
     * Strips blanks from both ends, in place.
     *
     * Contract: a text of n blanks becomes one of n - 1 blanks.
     */
    void trimString(std::string& text);

    /**
     * Replaces characters in place, from the second one on; a NUL ends the text and the scan.
     *
     * @param s  NUL-terminated
     */
    void strreplace(char* s, char from, char to);

    /** Halts the machine. Always true. */
    bool statusOffline();

    /** Restarts the machine. Always true. */
    bool statusReset();

    /**
     * Carries out one administration method, given as text: its name, then items of name, type and
     * value joined by colons, all separated by commas.
     *
     * Values become part of shell command lines as they are, apart from escaped blanks: whoever may
     * call this can run any command.
     *
     * @return true if the method succeeded
     */
    bool setCreateUser(std::string methodAndParams);

    // From here on 0 and false are success.

    /**
     * Takes a method-call text apart.
     *
     * A text or number parameter without a value ends the parsing without an error, and so does an
     * item that is not a parameter; the ones before it count.
     *
     * @param method  the first item; unchanged if there is none
     * @param params  appended to, even if the text is rejected later
     * @return 1 for an unknown type or an unreadable date
     */
    int parseMethodAndParams(std::string methodAndParams, std::string& method,
                             std::vector<ParamInfo>& params);

    /**
     * Maps a method to the system's account tools, runs them and judges what they print.
     *
     * A call that does not fit its command lines (39 arguments of 254 characters, 4999 characters
     * in all) fails and runs nothing.
     *
     * @param shadowing  written by GetShadowing only: whether /etc/shadow can be read
     */
    int executeMethod(std::string method, std::vector<ParamInfo> params, bool& shadowing);

    /**
     * Runs one command line through the shell, standard error merged in. Silence is success.
     *
     * @param program    path, with fixed options if any
     * @param arguments  the program's own entry, then the arguments up to the first empty one;
     *                   they are joined by blanks and not quoted
     * @param output     receives what was printed, NUL-terminated and truncated to the 5000 bytes
     *                   of the buffer
     * @return 1 if anything was printed or the command could not be run
     */
    int executeCommand(char* program, char** arguments, char* output);

    /** Sets a password with passwd, unless the user name is empty. Failures are not detected. */
    void executePasswordEncryption(char* password, char* user);

    /**
     * Adds a member to a group ("LocalGroupAddUser") or, for any other method, removes it.
     *
     * @return true for failure
     */
    bool groupMemberChanges(std::string method, std::vector<ParamInfo> params);
};

} // namespace NQ

#endif
