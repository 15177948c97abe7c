#ifndef MIHOST_CLI_ACCOUNTS_LOGINDEFS_H
#define MIHOST_CLI_ACCOUNTS_LOGINDEFS_H

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

constexpr char loginDefsFile[] = "/etc/login.defs";

/** The ids of ordinary accounts, or of ordinary groups. */
struct IdRange {
    char const* lowestKey; // such as UID_MIN
    char const* highestKey;
    std::optional<unsigned int> lowest; // nothing if the key has no number
    std::optional<unsigned int> highest;

    /** Whether the plug-in has a node for the id: one in the range, or 0. */
    bool holds(unsigned int id) const;

    /**
     * Why the plug-in has no node for the id, such as "uid 65534 is above UID_MAX 60000"; empty if
     * it has.
     *
     * @param what  "uid" or "gid"
     */
    std::string objectionTo(char const* what, unsigned int id) const;
};

/** The settings of /etc/login.defs. */
class LoginDefs
{
public:
    /** @param text  of the file */
    explicit LoginDefs(std::string const& text);

    /** As the plug-in reads them: keys begin a line, one character follows, then a number. */
    IdRange const& users() const
    {
        return users_;
    }
    IdRange const& groups() const
    {
        return groups_;
    }

    /** The keys of both ranges that have no number. */
    std::vector<std::string> missingKeys() const;

    /** ENCRYPT_METHOD as the account tools read it; empty if it is not set. */
    std::string const& encryptMethod() const
    {
        return encryptMethod_;
    }

private:
    IdRange users_{"UID_MIN", "UID_MAX", {}, {}};
    IdRange groups_{"GID_MIN", "GID_MAX", {}, {}};
    std::string encryptMethod_;
};

LoginDefs readLoginDefs();

} // namespace mihost

#endif
