#ifndef SYSDATA_USERINFO_LINUX_H
#define SYSDATA_USERINFO_LINUX_H

#include <string>
#include <vector>

namespace NQ
{

namespace USER_INFO
{

/** Logger category of this source unit. */
extern std::string loggerUserInfo;

/** An ageing field that holds no value: 0xFFFFFFFF, even if unsigned long is wider. */
extern unsigned long const never;

} // namespace USER_INFO

/**
 * One local account as of its listing, and the operations that change accounts.
 *
 * The operations act on the system by running its account tools and do not change the record; the
 * next listing shows their effect. A tool's failure is not noticed.
 */
class userInfo
{
public:
    userInfo();
    userInfo(std::string name);

    std::string getUserName();

    std::string getUserFullName();
    void setUserFullName(std::string fullName);

    std::string getUserHomeDir();
    void setUserHomeDir(std::string homeDir);

    /** The login shell. */
    std::string getUserScriptPath();
    void setUserScriptPath(std::string scriptPath);

    /** The encrypted password. */
    std::string getUserPassword();
    void setUserPassword(std::string password);

    /** The UID in decimal. */
    std::string getUserId();
    void setUserId(std::string userId);

    /** The primary GID in decimal. */
    std::string getGroupId();
    void setGroupId(std::string groupId);

    bool IsUserAcctDisabled();
    void setUserAcctDisabled(bool disabled);

    /** Always false: no deletion goes through the record. */
    bool IsDelete();

    // Days. The setters take the shadow file's numbers; never, and all bits set in the full width
    // of the argument, become the value that the system uses for an empty field.

    unsigned long getPwdMinDays();

    /** @param days  never becomes 0 */
    void setPwdMinDays(unsigned long days);

    unsigned long getPwdMaxDays();

    /** @param days  never becomes 99999 */
    void setPwdMaxDays(unsigned long days);

    unsigned long getPwdWarnDays();

    /** @param days  never becomes 7 */
    void setPwdWarnDays(unsigned long days);

    /** From the password's expiry until the account becomes inactive. */
    unsigned long getPwdExpDays();

    /** @param days  never becomes 99999 */
    void setPwdExpDays(unsigned long days);

    // Dates, in seconds since 1970. The setters take days, counted from 1 January 1970 00:00 in
    // local time.

    /** When the account expires. */
    unsigned long getPwdInactDays();

    /** @param days  never and 99999 become 19 January 2038, 00:00 local time */
    void setPwdInactDays(unsigned long days);

    unsigned long getLstPwdChg();

    /** @param days  Contract: never is counted as a number of days like any other */
    void setLstPwdChg(unsigned long days);

    long getPasswordHistoryDepth();
    void setPasswordHistoryDepth(long depth);

    long getMaxLoginFailures();
    void setMaxLoginFailures(long failures);

    /**
     * Deletes an account and its home directory with userdel.
     *
     * @return always 1
     */
    int setDelete(std::string user);

    /**
     * Lets the account become inactive on a date, by setting with chage how many days after the
     * password's expiry that is; 99999 if the date is before the expiry.
     *
     * @param date  "YYYY-MM-DD 00:00:00"
     * @return whether chage could be started
     */
    bool setInactivityTimeout(std::string date, std::string user);

    /**
     * Lets the present password expire on a date, by setting its maximum age with chage; 99999
     * days if the date is before the last change.
     *
     * @param date  "YYYY-MM-DD 00:00:00"
     * @return whether chage could be started
     */
    bool setPasswordExpiration(std::string date, std::string user);

    /**
     * Whole days from a date that a command prints, as "LABEL : Mon DD, YYYY", to a time.
     *
     * A date that is missing or cannot be read counts as 1970-01-01 00:00 UTC.
     *
     * @param command    shell command line
     * @param label      what the date's line begins with
     * @param reference  seconds since 1970
     * @return 99999 if the command cannot be started or the date is after the reference
     */
    long getDays(char* command, char* label, long reference);

    /** Asks passwd whether the account is locked; false if that cannot be determined. */
    bool findIsAcctDisabled(char* user);

    /**
     * Runs a shell command line made of a command and its arguments, standard error merged in.
     *
     * @param args    the program itself, which is not used, then the arguments; ends at the first
     *                empty text after the program
     * @param output  receives all of the output and a NUL: make it large enough
     * @return whether there was any output
     */
    bool executeLinCommand(char* command, char const* const* args, char* output);

private:
    std::string userName_;
    std::string fullName_;
    std::string homeDir_;
    std::string scriptPath_;
    std::string password_;
    std::string userId_;
    std::string groupId_;
    bool acctDisabled_ = false;
    bool delete_ = false;
    unsigned long pwdMinDays_ = 0;
    unsigned long pwdMaxDays_ = 0;
    unsigned long pwdWarnDays_ = 0;
    long passwordHistoryDepth_ = 0;
    long maxLoginFailures_ = 0;
    unsigned long pwdInactDays_ = 0;
    unsigned long lstPwdChg_ = 0;
    unsigned long pwdExpDays_ = 0;
};

/**
 * Lists the ordinary accounts and those with UID 0, in the order of /etc/passwd.
 *
 * The list is emptied first and stays empty if /etc/passwd cannot be read. Password and ageing
 * come from /etc/shadow as long as it names the accounts in the same order. The system's account
 * lock is held for the whole listing; it does not exclude other threads of this
 * process.
 */
void getUserInfo(std::vector<userInfo>& users);

} // namespace NQ

#endif
