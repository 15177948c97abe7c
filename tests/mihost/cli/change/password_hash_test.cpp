#include "mihost/cli/change/PasswordHash.h"
#include "tests/mihost/cli/Refusal.h"

namespace password_hash_test
{

using mihost::escapedForShell;
using mihost::fits;
using mihost::hashOf;

TEST(PasswordHash, FitsOnlyItsOwnPassword)
{
    std::string const hash = hashOf("geheim42");
    EXPECT_TRUE(fits("geheim42", hash));
    EXPECT_FALSE(fits("geheim43", hash));
    EXPECT_FALSE(fits("geheim42", "geheim42")); // plain text is not a hash
    EXPECT_FALSE(fits("geheim42", ""));
    EXPECT_FALSE(fits("geheim42", "!"));
}

TEST(PasswordHash, HasANewSaltEachTime)
{
    EXPECT_NE(hashOf("geheim42"), hashOf("geheim42"));
}

TEST(PasswordHash, IsRefusedForAPasswordThatLibcryptCannotHash)
{
    EXPECT_NE(refusal([] { hashOf(std::string(600, 'x')); }).find("libcrypt cannot hash it"),
              std::string::npos);
}

TEST(PasswordHash, IsEscapedCharacterByCharacter)
{
    EXPECT_EQ(escapedForShell("$y$j9T$a./B0"), "\\$y\\$j9T\\$a./B0");
    EXPECT_EQ(escapedForShell("$6$rounds=9$*`\\;"), "\\$6\\$rounds\\=9\\$\\*\\`\\\\\\;");
}

} // namespace password_hash_test
