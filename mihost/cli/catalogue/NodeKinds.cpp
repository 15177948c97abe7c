// The kinds of nodes and their properties.

#include "host/Properties.h"
#include "mihost/cli/catalogue/CatalogueRows.h"

namespace mihost
{

namespace
{

namespace property = IC::property;
namespace nodeType = IC::nodeType;

using namespace rows;

PropertyRow const requestedState =
    enumeration(property::requestedState, "requested-state", "fixed: 1");
PropertyRow const fixedNumbers =
    numbers(property::fixedNumbers, "fixed-numbers", "fixed: 0, 1, 24");

std::vector<Property> const computerProperties = {
    text(property::name, "computer-name", "the machine's network node name"),
};

std::vector<Property> const osProperties = {
    enumeration(property::fixedEnumeration, "fixed-enumeration", "fixed: 35"),
    enumeration(property::requestedState, "requested-state",
                "starts as 1; writing 9 restarts the machine, 12 halts it")
        .acts(),
    fixedNumbers,
    text(property::name, "os-name", "first line of the distribution's release file, else Linux"),
    text(property::version, "os-version",
         "the distribution's version; unset if no release file is known"),
    text(property::createUser, "create-user",
         "writing a method-call text runs an administration method; empty after a failure")
        .acts()
        .mayBeSecret()
        .takes(Form::MethodCall),
    number(property::refresh, "refresh", "writing 0 rebuilds the user and group nodes").acts(),
    boolean(property::distributed, "distributed", "fixed: false"),
    number(property::processMaxNumber, "process-max-number", "fixed: 32000").in("processes"),
    number(property::processMaxMemory, "process-max-memory", "fixed: 0"),
    number(property::userCount, "user-count", "ordinary accounts and those with UID 0, at start-up")
        .in("accounts"),
    number(property::licensedUserCount, "licensed-user-count", "fixed: 0").in("accounts"),
    number(property::virtualMemorySize, "virtual-memory-size", "fixed: 0"),
    number(property::virtualMemoryFree, "virtual-memory-free", "fixed: 0"),
    text(property::languageEdition, "language-edition",
         "language tag of the locale, such as en-US"),
    text(property::codeSet, "code-set", "code set of the locale, such as UTF-8"),
    number(property::processCount, "process-count", "current number of processes")
        .in("processes")
        .live(),
    number(property::physicalMemoryFree, "physical-memory-free", "free RAM").in("KiB").live(),
    number(property::physicalMemorySize, "physical-memory-size", "RAM").in("KiB").live(),
    number(property::swapFileSize, "swap-size", "swap space, unscaled; truncated to 32 bits")
        .in("kernel memory units")
        .live(),
    number(property::swapFileFree, "swap-free", "free swap space, unscaled; truncated to 32 bits")
        .in("kernel memory units")
        .live(),
    number(property::swapFileSizeStored, "swap-used",
           "swap space in use, unscaled; truncated to 32 bits")
        .in("kernel memory units")
        .live(),
    date(property::lastBootTime, "last-boot-time", "when the machine was started"),
    date(property::installDate, "install-date",
         "last status change of the release file; the epoch if there is none"),
    number(property::clearLog, "clear-log", "always reads 0; writing 9 empties the system log")
        .live()
        .unstored()
        .acts(),
};

std::vector<Property> const driverProperties = {
    text(property::version, "driver-version", "the module's version; empty if it has none"),
    text(property::name, "driver-name", "the module's name"),
    text(property::buildNumber, "build-number", "always empty"),
    text(property::manufacturer, "manufacturer", "always empty"),
};

std::vector<Property> const userProperties = {
    requestedState,
    fixedNumbers,
    text(property::name, "user-name", "login name; account commands use it")
        .takes(Form::AccountName),
    number(property::nameLength, "user-name-length", "length of the login name").in("bytes"),
    text(property::id, "user-id", "UID in decimal; a deletion uses it").takes(Form::Digits),
    number(property::idLength, "user-id-length", "length of the UID's text").in("bytes"),
    text(property::groupId, "group-id", "GID of the primary group in decimal").takes(Form::Digits),
    text(property::fullName, "full-name", "the account's comment field"),
    text(property::homeDir, "home-directory", "home directory"),
    text(property::scriptPath, "login-shell", "login shell"),
    text(property::password, "password", "password hash; writing a hash sets it")
        .acts()
        .secret()
        .takes(Form::Hash),
    number(property::passwordLength, "password-length", "length of the password hash").in("bytes"),
    number(property::pwdMaxDays, "password-max-days", "maximum password age; 99999 for no limit")
        .in("days"),
    number(property::pwdWarnDays, "password-warn-days", "warning before a password expires")
        .in("days"),
    number(property::pwdMinDays, "password-min-days", "minimum password age").in("days"),
    number(property::pwdExpDays, "password-expiry-days",
           "from a password's expiry until the account becomes inactive; 99999 for never")
        .in("days"),
    date(property::inactiveTime, "inactive-time",
         "reads the account's expiry date, 2038-01-19 for never; writing a date sets when the "
         "account becomes inactive")
        .acts(),
    number(property::passwordHistoryDepth, "password-history-depth", "fixed: 0"),
    text(property::reservedText, "reserved-text", "fixed: empty"),
    date(property::passwordExpiration, "password-expiration",
         "reads the account's expiry date, as inactive-time does; writing a date sets the "
         "password's")
        .acts(),
    date(property::lastPwdChange, "last-password-change", "when the password was last changed"),
    number(property::maxLoginFailures, "max-login-failures",
           "the deny= of /etc/pam.d/login, 0 for none"),
    boolean(property::deleteUser, "delete",
            "reads false; writing true deletes the account whose name is this UID, with its home "
            "directory")
        .acts(),
    number(property::elementCount, "user-count", "current number of reported accounts")
        .in("accounts")
        .live(),
};

std::vector<Property> const groupProperties = {
    text(property::name, "group-name", "the group's name"),
    number(property::id, "group-id", "GID"),
    texts(property::members, "members",
          "login names: users with this primary group, then listed members"),
    number(property::elementCount, "group-count", "current number of reported groups")
        .in("groups")
        .live(),
};

std::vector<Property> const logProperties = {
    requestedState,
    fixedNumbers,
    number(property::logNumber, "log-number", "fixed: 0"),
    text(property::name, "log-name", "fixed: OS Log"),
    enumeration(property::logState, "log-state", "fixed: 2"),
    text(property::dataType, "data-type", "fixed: *string LogData*"),
};

std::vector<Property> const logEntryProperties = {
    number(property::id, "index", "position from the newest line, which is 1").live(),
    text(property::message, "message", "the line without its time stamp, between asterisks").live(),
    date(property::creationTime, "time", "the line's time stamp, read as local time").live(),
};

std::vector<NodeKind> const kinds = {
    one(nodeType::osSw, "mi", "the management interface itself"),
    one(nodeType::root, "root", "root of the machine's tree"),
    one(nodeType::computer, "computer", "the machine")
        .showing(property::name)
        .having(computerProperties),
    one(nodeType::operatingSystem, "os", "the operating system: facts, commands and methods")
        .showing(property::name)
        .having(osProperties),
    several(nodeType::driver, "driver", property::name, "a loaded kernel module")
        .showing(property::version)
        .listedAs("drivers", {"driver-name", "driver-version", "description"})
        .having(driverProperties),
    several(nodeType::user, "user", property::name,
            "a local user account: ordinary ones and those with UID 0")
        .showing(property::fullName)
        .listedAs("users", {"user-name", "user-id", "group-id", "home-directory", "login-shell",
                            "full-name"})
        .having(userProperties),
    several(nodeType::group, "group", property::name, "a local group: ordinary ones and GID 0")
        .showing(property::members)
        .listedAs("groups", {"group-name", "group-id", "members"})
        .having(groupProperties),
    one(nodeType::log, "log", "the system log, /var/log/messages").having(logProperties),
    several(nodeType::logEntry, "log-entry", property::id,
            "one of the 50 newest lines of the system log")
        .addressedAs("log")
        .showing(property::message)
        .listedAs("log", {"index", "time", "message"})
        .having(logEntryProperties),
};

} // namespace

std::vector<NodeKind> const& nodeKinds()
{
    return kinds;
}

} // namespace mihost
