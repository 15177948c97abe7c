#ifndef HOST_PROPERTIES_H
#define HOST_PROPERTIES_H

/*
 * The numbers of node types, properties and commands. Contract: none may change, since hosts use
 * them.
 *
 * Constants rather than enumerations: setProperty takes ids by reference to unsigned int.
 */
namespace IC
{

/** What MutableNode::getNodeType returns. */
namespace nodeType
{

constexpr unsigned int operatingSystem = 17;
constexpr unsigned int log = 35;
constexpr unsigned int osSw = 39;
constexpr unsigned int computer = 40;
constexpr unsigned int driver = 44;
constexpr unsigned int user = 46;
constexpr unsigned int logEntry = 47;
constexpr unsigned int group = 51;
constexpr unsigned int root = 59;

} // namespace nodeType

/** The status that every node has. */
constexpr unsigned int statusOk = 1;

/** The ids that getProperty and setProperty take. */
namespace property
{

// On several kinds of node.
constexpr unsigned int elementCount = 51; // users or groups, on their nodes
constexpr unsigned int id = 89;           // UID as text, GID or log index as number
constexpr unsigned int name = 108;
constexpr unsigned int requestedState = 123;
constexpr unsigned int fixedNumbers = 125;
constexpr unsigned int version = 134;

// Operating system.
constexpr unsigned int createUser = 74;
constexpr unsigned int refresh = 75;
constexpr unsigned int fixedEnumeration = 128;
constexpr unsigned int installDate = 139;
constexpr unsigned int distributed = 140;
constexpr unsigned int lastBootTime = 141;
constexpr unsigned int processMaxNumber = 142;
constexpr unsigned int processMaxMemory = 143;
constexpr unsigned int processCount = 144;
constexpr unsigned int userCount = 145;
constexpr unsigned int licensedUserCount = 146;
constexpr unsigned int virtualMemorySize = 147;
constexpr unsigned int virtualMemoryFree = 148;
constexpr unsigned int physicalMemoryFree = 149;
constexpr unsigned int physicalMemorySize = 150;
constexpr unsigned int swapFileSize = 151;
constexpr unsigned int swapFileSizeStored = 152;
constexpr unsigned int swapFileFree = 153;
constexpr unsigned int codeSet = 154;
constexpr unsigned int languageEdition = 155;
constexpr unsigned int clearLog = 191;

// Driver.
constexpr unsigned int manufacturer = 36;
constexpr unsigned int buildNumber = 70;

// User account.
constexpr unsigned int pwdExpDays = 44;
constexpr unsigned int idLength = 90;
constexpr unsigned int passwordExpiration = 91;
constexpr unsigned int maxLoginFailures = 106;
constexpr unsigned int nameLength = 109;
constexpr unsigned int reservedText = 113;
constexpr unsigned int password = 117;
constexpr unsigned int inactiveTime = 118;
constexpr unsigned int passwordHistoryDepth = 119;
constexpr unsigned int passwordLength = 120;
constexpr unsigned int deleteUser = 138;
constexpr unsigned int homeDir = 158;
constexpr unsigned int scriptPath = 159;
constexpr unsigned int lastPwdChange = 160;
constexpr unsigned int pwdMinDays = 161;
constexpr unsigned int pwdWarnDays = 162;
constexpr unsigned int pwdMaxDays = 163;
constexpr unsigned int groupId = 311;
constexpr unsigned int fullName = 312;

// Group.
constexpr unsigned int members = 165;

// Log and log entry.
constexpr unsigned int logNumber = 37;
constexpr unsigned int creationTime = 79;
constexpr unsigned int message = 81;
constexpr unsigned int dataType = 84;
constexpr unsigned int logState = 114;

} // namespace property

/** The numbers that act when written to a command property; others are only stored. */
namespace command
{

constexpr unsigned int restart = 9;       // to requestedState
constexpr unsigned int halt = 12;         // to requestedState
constexpr unsigned int emptyLog = 9;      // to clearLog
constexpr unsigned int rebuild = 0;       // to refresh
constexpr unsigned int deleteAccount = 1; // to deleteUser

} // namespace command

} // namespace IC

#endif
