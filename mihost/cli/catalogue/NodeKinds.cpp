// The kinds of nodes and their properties.

#include "mihost/cli/catalogue/Rows.h"
#include "nodes/ids.h"

namespace mihost
{

namespace
{

using namespace rows;

PropertyRow const requestedState =
    enumeration(NODES::requestedState, "requested-state", "fixed: 1");
PropertyRow const fixedNumbers = numbers(NODES::fixedNumbers, "fixed-numbers", "fixed: 0, 1, 24");

std::vector<Property> const computerProperties = {
    text(NODES::name, "computer-name", "the machine's network node name"),
};

std::vector<Property> const osProperties = {
    enumeration(NODES::fixedEnumeration, "fixed-enumeration", "fixed: 35"),
    enumeration(NODES::requestedState, "requested-state",
                "starts as 1; writing 9 restarts the machine, 12 halts it")
        .acts(),
    fixedNumbers,
    text(NODES::name, "os-name", "first line of the distribution's release file, else Linux"),
    text(NODES::version, "os-version",
         "the distribution's version; unset where no release file is known"),
    text(NODES::createUser, "create-user",
         "writing a method-call text carries out an administration method; empty after a failure")
        .acts()
        .mayBeSecret()
        .takes(Form::MethodCall),
    number(NODES::refresh, "refresh", "writing 0 builds the user and group nodes again").acts(),
    boolean(NODES::distributed, "distributed", "fixed: false"),
    number(NODES::processMaxNumber, "process-max-number", "fixed: 32000").in("processes"),
    number(NODES::processMaxMemory, "process-max-memory", "fixed: 0"),
    number(NODES::userCount, "user-count", "ordinary accounts and those with UID 0, at the start")
        .in("accounts"),
    number(NODES::licensedUserCount, "licensed-user-count", "fixed: 0").in("accounts"),
    number(NODES::virtualMemorySize, "virtual-memory-size", "fixed: 0"),
    number(NODES::virtualMemoryFree, "virtual-memory-free", "fixed: 0"),
    text(NODES::languageEdition, "language-edition", "language tag of the locale, such as en-US"),
    text(NODES::codeSet, "code-set", "code set of the locale, such as UTF-8"),
    number(NODES::processCount, "process-count", "processes at this moment").in("processes").live(),
    number(NODES::physicalMemoryFree, "physical-memory-free", "free RAM").in("KiB").live(),
    number(NODES::physicalMemorySize, "physical-memory-size", "RAM").in("KiB").live(),
    number(NODES::swapFileSize, "swap-size", "swap space, not scaled; cut to 32 bits")
        .in("kernel memory units")
        .live(),
    number(NODES::swapFileFree, "swap-free", "free swap space, not scaled; cut to 32 bits")
        .in("kernel memory units")
        .live(),
    number(NODES::swapFileSizeStored, "swap-used", "swap space in use, not scaled; cut to 32 bits")
        .in("kernel memory units")
        .live(),
    date(NODES::lastBootTime, "last-boot-time", "when the machine was started"),
    date(NODES::installDate, "install-date",
         "last status change of the release file; the epoch where there is none"),
    number(NODES::clearLog, "clear-log", "always reads 0; writing 9 empties the system log")
        .live()
        .unstored()
        .acts(),
};

std::vector<Property> const driverProperties = {
    text(NODES::version, "driver-version", "the module's version; empty where it states none"),
    text(NODES::name, "driver-name", "the module's name"),
    text(NODES::buildNumber, "build-number", "always empty"),
    text(NODES::manufacturer, "manufacturer", "always empty"),
};

std::vector<Property> const userProperties = {
    requestedState,
    fixedNumbers,
    text(NODES::name, "user-name", "login name; account commands take it from here")
        .takes(Form::AccountName),
    number(NODES::nameLength, "user-name-length", "length of the login name").in("bytes"),
    text(NODES::id, "user-id", "UID in decimal; a delete takes it from here").takes(Form::Digits),
    number(NODES::idLength, "user-id-length", "length of the UID's text").in("bytes"),
    text(NODES::groupId, "group-id", "GID of the primary group in decimal").takes(Form::Digits),
    text(NODES::fullName, "full-name", "the account's comment field"),
    text(NODES::homeDir, "home-directory", "home directory"),
    text(NODES::scriptPath, "login-shell", "login shell"),
    text(NODES::password, "password", "password hash; writing a hash sets it")
        .acts()
        .secret()
        .takes(Form::Hash),
    number(NODES::passwordLength, "password-length", "length of the password hash").in("bytes"),
    number(NODES::pwdMaxDays, "password-max-days",
           "how long a password stays valid; 99999 means for ever")
        .in("days"),
    number(NODES::pwdWarnDays, "password-warn-days", "warning before a password expires")
        .in("days"),
    number(NODES::pwdMinDays, "password-min-days", "wait before a password may be changed")
        .in("days"),
    number(NODES::pwdExpDays, "password-expiry-days",
           "from a password's expiry until the account goes inactive; 99999 means never")
        .in("days"),
    date(NODES::inactiveTime, "inactive-time",
         "account expiry, 2038-01-19 for never; writing a day makes the account inactive from then "
         "on")
        .acts(),
    number(NODES::passwordHistoryDepth, "password-history-depth", "fixed: 0"),
    text(NODES::reservedText, "reserved-text", "fixed: empty"),
    date(NODES::passwordExpiration, "password-expiration",
         "account expiry, as inactive-time; writing a day lets the password expire then")
        .acts(),
    date(NODES::lastPwdChange, "last-password-change", "when the password was last changed"),
    number(NODES::maxLoginFailures, "max-login-failures",
           "the deny= of /etc/pam.d/login, 0 for none"),
    boolean(NODES::deleteUser, "delete",
            "reads false; writing true deletes the account that is named like this UID, home "
            "directory included")
        .acts(),
    number(NODES::elementCount, "user-count", "reported accounts at this moment")
        .in("accounts")
        .live(),
};

std::vector<Property> const groupProperties = {
    text(NODES::name, "group-name", "the group's name"),
    number(NODES::id, "group-id", "GID"),
    texts(NODES::members, "members",
          "login names: those whose primary group it is, then those it lists"),
    number(NODES::elementCount, "group-count", "reported groups at this moment")
        .in("groups")
        .live(),
};

std::vector<Property> const logProperties = {
    requestedState,
    fixedNumbers,
    number(NODES::logNumber, "log-number", "fixed: 0"),
    text(NODES::name, "log-name", "fixed: OS Log"),
    enumeration(NODES::logState, "log-state", "fixed: 2"),
    text(NODES::dataType, "data-type", "fixed: *string LogData*"),
};

std::vector<Property> const logEntryProperties = {
    number(NODES::id, "index", "position counted from the newest line, which is 1").live(),
    text(NODES::message, "message", "the line without its time stamp, between asterisks").live(),
    date(NODES::creationTime, "time", "the line's time stamp, read as local time").live(),
};

std::vector<NodeKind> const kinds = {
    one(NODES::osSwType, "mi", "the management interface itself"),
    one(NODES::rootType, "root", "root of the machine's tree"),
    one(NODES::computerType, "computer", "the machine")
        .showing(NODES::name)
        .having(computerProperties),
    one(NODES::operatingSystemType, "os", "the operating system: facts, commands and methods")
        .showing(NODES::name)
        .having(osProperties),
    several(NODES::driverType, "driver", NODES::name, "a loaded kernel module")
        .showing(NODES::version)
        .listedAs("drivers", {"driver-name", "driver-version", "description"})
        .having(driverProperties),
    several(NODES::userType, "user", NODES::name,
            "a local user account: ordinary ones and those with UID 0")
        .showing(NODES::fullName)
        .listedAs("users", {"user-name", "user-id", "group-id", "full-name", "home-directory",
                            "login-shell"})
        .having(userProperties),
    several(NODES::groupType, "group", NODES::name, "a local group: ordinary ones and GID 0")
        .showing(NODES::members)
        .listedAs("groups", {"group-name", "group-id", "members"})
        .having(groupProperties),
    one(NODES::logType, "log", "the system log, /var/log/messages").having(logProperties),
    several(NODES::logEntryType, "log-entry", NODES::id,
            "one of the 50 newest lines of the system log")
        .addressedAs("log")
        .showing(NODES::message)
        .listedAs("log", {"index", "time", "message"})
        .having(logEntryProperties),
};

} // namespace

std::vector<NodeKind> const& nodeKinds()
{
    return kinds;
}

} // namespace mihost
