#include "mihost/cli/change/UserCheck.h"

#include <cctype>
#include <gtest/gtest.h>

namespace user_check_test
{

using mihost::Account;
using mihost::objectionToUserWrite;
using mihost::UserWrite;

std::vector<Account> const accounts = {
    {"root", "0"},   {"jdoe", "1500"}, {"1500", "1077"},
    {"ann", "1001"}, {"1002", "1002"}, {"ann", "0"},
};

std::string objectionToDelete(Account const& node)
{
    return objectionToUserWrite(node, UserWrite::Delete, accounts).value_or("none");
}

std::string objectionToChange(Account const& node)
{
    return objectionToUserWrite(node, UserWrite::Change, accounts).value_or("none");
}

TEST(UserDelete, IsRefusedUnlessTheUidIsTheNameOfTheAccount)
{
    EXPECT_EQ(objectionToDelete({"jdoe", "1500"}),
              "userdel would get the UID 1500, which is the name of another account: '1500' "
              "would be deleted (use 'mihost user delete jdoe', which keeps the home "
              "directory)");
    EXPECT_EQ(objectionToDelete({"ann", "1001"}),
              "userdel would get the UID 1001, but accepts only names (use 'mihost user delete "
              "ann', which keeps the home directory)");
    EXPECT_EQ(objectionToDelete({"1002", "1002"}), "none");
}

TEST(UserWrites, AreRefusedIfTheyWouldNotReachTheAccountOfTheNode)
{
    for (Account const& account : {accounts[0], accounts[1], accounts[2], accounts[3]})
        EXPECT_EQ(objectionToChange(account), "none") << account.name;
    EXPECT_EQ(objectionToChange({"gone", "1001"}),
              "no account is named 'gone' (run 'mihost refresh')");
    EXPECT_EQ(objectionToChange({"jdoe", "1501"}),
              "'jdoe' is now an account with UID 1500, not 1501 (run 'mihost refresh')");
    // Of two accounts with one name, tools take the first.
    EXPECT_EQ(objectionToChange({"ann", "0"}),
              "'ann' is now an account with UID 1001, not 0 (run 'mihost refresh')");
}

TEST(UserWrites, AreRefusedForEachUnsafeByte)
{
    for (int byte = 1; byte < 256; ++byte) {
        bool const isNamePart =
            std::isalnum(byte) ||
            std::string("@+-./_").find(static_cast<char>(byte)) != std::string::npos;
        for (std::string const& name :
             {std::string("ab"), std::string("a") + static_cast<char>(byte) + "b"}) {
            Account const account{name, "1000"};
            bool const isRefused =
                objectionToUserWrite(account, UserWrite::Change, {account}).has_value();
            EXPECT_EQ(isRefused, name.size() == 3 && (byte >= 0x80 || !isNamePart)) << byte;
        }
        Account const oddId{"jdoe", std::string("1") + static_cast<char>(byte)};
        EXPECT_EQ(objectionToUserWrite(oddId, UserWrite::Change, {oddId}).has_value(),
                  !std::isdigit(byte))
            << byte;
    }
}

} // namespace user_check_test
