#ifndef SYSDATA_LOGINFO_LINUX_H
#define SYSDATA_LOGINFO_LINUX_H

#include <string>

namespace NQ
{

/** Logger category of this source unit. */
extern std::string loggerLogInfo;

/**
 * Reads the system log, /var/log/messages, a line at a time, and empties it.
 *
 * Entries are counted from the newest: index 1 is the last line of the file. Nothing is cached:
 * each call runs its own commands, so an index means another line once the log has grown.
 */
class logInfo
{
public:
    logInfo();
    ~logInfo();

    /** Number of lines in the log; 0 if they cannot be counted. */
    unsigned int getMaxLine();

    /**
     * Copies one line without its leading blanks and its end; empty if there is no such line or it
     * cannot be read.
     *
     * @param line    counted from 1 at the top of the file
     * @param buffer  takes length bytes, the rest after the text filled with NUL. Contract: a text
     *                of that length or more is truncated and gets no NUL
     * @param length  at least 1
     */
    void getLog(unsigned int line, char* buffer, int length);

    /**
     * The message of an entry, without its time stamp, between two asterisks.
     *
     * Contract: 0 and the index after the oldest entry are accepted and read as an empty message.
     *
     * @param text  unchanged on failure
     * @return whether there is such an entry
     */
    bool getData(std::string& text, unsigned int index);

    /**
     * The time stamp of an entry, read as local time, in the current year or the one before.
     *
     * @param time  seconds since 1970, 0 if the current year is unknown or out of range; unchanged
     *              on failure
     * @return whether there is such an entry with a time stamp
     */
    bool getCreationTime(long& time, unsigned int index);

    /** Truncates the log file to nothing. */
    bool clearLog();

    /**
     * Replaces characters in place, from the second one on; a NUL ends the text and the scan.
     *
     * @param str  NUL-terminated
     */
    void strreplace(char* str, char from, char to);

private:
    std::string unused_; // Contract: hosts know the size of the object
};

} // namespace NQ

#endif
