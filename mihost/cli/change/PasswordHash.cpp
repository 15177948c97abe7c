#include "mihost/cli/change/PasswordHash.h"

#include "mihost/cli/accounts/LoginDefs.h"
#include "mihost/cli/input/InputValidation.h"
#include "mihost/cli/plugin/CommandTap.h"
#include "mihost/cli/system/Failure.h"

#include <algorithm>
#include <cctype>
#include <crypt.h>
#include <iterator>

namespace mihost
{

namespace
{

struct HashMethod {
    char const* name; // as ENCRYPT_METHOD of /etc/login.defs
    char const* prefix;
};

constexpr HashMethod hashMethods[] = {
    {"YESCRYPT", "$y$"},
    {"SHA512", "$6$"},
    {"SHA256", "$5$"},
    {"BCRYPT", "$2b$"},
};

/** Null, libcrypt's own choice, also for methods that are too weak by now. */
char const* systemPrefix()
{
    std::string const name = readLoginDefs().encryptMethod();
    auto const found =
        std::find_if(std::begin(hashMethods), std::end(hashMethods),
                     [&name](HashMethod const& method) { return name == method.name; });
    return found == std::end(hashMethods) ? nullptr : found->prefix;
}

std::string hashWith(std::string const& password, char const* prefix)
{
    char const* const setting = crypt_gensalt(prefix, 0, nullptr, 0);
    char const* const hash = setting ? crypt(password.c_str(), setting) : nullptr;
    return hash ? hash : "";
}

} // namespace

bool passwdReadsStdin()
{
    static bool const does =
        commandTap::outputOf("LC_ALL=C /usr/bin/passwd --help 2>&1").find("--stdin") !=
        std::string::npos;
    return does;
}

std::string hashOf(std::string const& password)
{
    std::string hash = hashWith(password, systemPrefix());
    bool const separates = hash.find_first_of(",:") != std::string::npos;
    if (!fits(password, hash) || objectionToHash(hash) || separates ||
        escapedForShell(hash).size() > longestArgument)
        throw Failure(BadUsage, "hashing the password: this machine's passwd cannot read it from a "
                                "pipe, and libcrypt cannot hash it (set it with passwd)");
    return hash;
}

bool fits(std::string const& password, std::string const& hash)
{
    char const* const again = crypt(password.c_str(), hash.c_str());
    return again && !hash.empty() && hash == again;
}

std::string escapedForShell(std::string const& hash)
{
    std::string escaped;
    for (char const character : hash) {
        bool const isPlain = std::isalnum(static_cast<unsigned char>(character)) != 0 ||
                             character == '.' || character == '/';
        if (!isPlain)
            escaped += '\\';
        escaped += character;
    }
    return escaped;
}

} // namespace mihost
