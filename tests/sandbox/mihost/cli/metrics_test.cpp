// Metrics of a machine whose figures are known.

#include "mihost/cli/input/Day.h"
#include "mihost/cli/system/TextFile.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <ctime>
#include <filesystem>
#include <fmt/format.h>

namespace metrics_test
{

/** Days since 1970 of the day that is this many days after today. */
long dayFromToday(long days)
{
    std::time_t const now = std::time(nullptr);
    std::tm today{};
    localtime_r(&now, &today);
    return mihost::dayNumber({today.tm_year + 1900, today.tm_mon + 1, today.tm_mday}) + days;
}

class Metrics : public testing::Test
{
protected:
    Metrics()
    {
        machine::lay("plain");
        machine::writeIdRanges();
        std::string accounts = "root:x:0:0:root:/root:/bin/sh\n";
        std::string shadow = "root:$6$r$hash:19000:0:99999:7:::\n";
        auto const add = [&](int id, std::string const& rest) {
            accounts += fmt::format("user{0}:x:{0}:1000::/:/bin/sh\n", id);
            shadow += fmt::format("user{}:{}\n", id, rest);
        };
        add(1000, fmt::format("$6$a$hash:19000:0:99999:7::{}:", dayFromToday(3)));
        add(1001, fmt::format("!$6$a$hash:19000:0:99999:7::{}:", dayFromToday(20)));
        add(1002, fmt::format("*:0:0:99999:7::{}:", dayFromToday(-1)));
        add(1003, fmt::format("$6$a$hash:19000:0:99999:7::{}:", dayFromToday(40)));
        add(1004, "$6$a$hash:19000:0:99999:7:::");
        add(1005, "no-hash:19000:0:99999:7:::");
        machine::write("/etc/passwd", accounts);
        machine::write("/etc/shadow", shadow, 0600);
        machine::write("/etc/group", "root:x:0:\ncrew:x:1000:user1000\nother:x:1001:\n");
        machine::write("/var/log/messages", "Jan  2 03:04:05 host x: y\n"
                                            "Jan  2 03:04:06 host x: z\n");
        machine::fake("/usr/sbin/lsmod", "echo Module Size Used by\necho one 1 0\necho two 1 0\n");
        machine::fake("/usr/sbin/modinfo", "echo 'version:        1.2'\n");
        kernelModules::load({});
    }

    static std::vector<std::string> lines(std::vector<std::string> arguments = {"metrics"})
    {
        Outcome const outcome = mihostRun(std::move(arguments));
        EXPECT_EQ(outcome.code, 0) << outcome.err;
        return mihost::linesOf(outcome.out);
    }

    /** The value of a series, as it is written; empty for none. */
    static std::string valueOf(std::string const& series, std::vector<std::string> const& from)
    {
        for (std::string const& line : from)
            if (line.compare(0, series.size() + 1, series + " ") == 0)
                return line.substr(series.size() + 1);
        return "";
    }

    static std::string treeValue(std::string const& node, std::string const& property)
    {
        Outcome const outcome = mihostRun({"--json", "get", node, property});
        Json const properties = Json::parse(outcome.out)["properties"];
        return properties.begin().value()["value"].dump();
    }
};

TEST_F(Metrics, HaveTheValuesOfTheTree)
{
    auto const all = lines();
    // Each run computes it from the time, which may be late by a tick, and the uptime, both in
    // whole seconds.
    EXPECT_NEAR(std::stod(valueOf("mi_boot_time_seconds", all)),
                std::stod(treeValue("os", "last-boot-time")), 2);
    std::string const kib = treeValue("os", "physical-memory-size");
    EXPECT_EQ(valueOf("mi_memory_size_bytes", all), std::to_string(std::stoull(kib) * 1024));
    EXPECT_EQ(valueOf("mi_users", all), "7");
    EXPECT_EQ(valueOf("mi_groups", all), "3");
    EXPECT_EQ(valueOf("mi_log_lines", all), "2");
    EXPECT_EQ(valueOf("mi_log_newest_time_seconds", all), treeValue("log:1", "time"));
    EXPECT_EQ(valueOf("mi_collection_success", all), "1");
    EXPECT_GT(std::stod(valueOf("mi_collection_duration_seconds", all)), 0);
    EXPECT_EQ(all.back(), "# EOF");
}

TEST_F(Metrics, HaveLabelsAndCountAccountsByTheirState)
{
    auto const all = lines({"--no-accel", "metrics"});
    EXPECT_EQ(valueOf("mi_drivers", all), "2");
    EXPECT_EQ(valueOf(R"(mi_driver_info{driver="one",version="1.2"})", all), "1");
    EXPECT_EQ(valueOf(R"(mi_accounts_expiring{days="7"})", all), "1");
    EXPECT_EQ(valueOf(R"(mi_accounts_expiring{days="30"})", all), "2");
    EXPECT_EQ(valueOf("mi_accounts_expired", all), "1");
    EXPECT_EQ(valueOf("mi_accounts_disabled", all), "3");
    EXPECT_EQ(valueOf("mi_accounts_password_never_changed", all), "1");
    Json const expected = {
        {"metric", "mi_accounts_expiring"}, {"labels", {{"days", "7"}}}, {"value", 1.0}};
    Json const list = mihostJson({"metrics"});
    EXPECT_NE(std::find(list.begin(), list.end(), expected), list.end());
}

TEST_F(Metrics, NameNoAccountUnlessRequestedAndNoHash)
{
    for (std::string const& line : lines())
        EXPECT_FALSE(holds(line, "user1"));
    auto const all = lines({"--show-secrets", "metrics", "--accounts"});
    for (std::string const& line : all)
        EXPECT_FALSE(holds(line, "$6$"));
    EXPECT_EQ(valueOf(R"(mi_account_disabled{user="user1001"})", all), "1");
    EXPECT_EQ(valueOf(R"(mi_account_disabled{user="user1000"})", all), "0");
    EXPECT_EQ(valueOf(R"(mi_account_password_change_time_seconds{user="user1002"})", all), "0");
    EXPECT_EQ(valueOf(R"(mi_account_expiry_time_seconds{user="user1003"})", all),
              treeValue("user:user1003", "inactive-time"));
    EXPECT_EQ(valueOf(R"(mi_account_expiry_time_seconds{user="user1004"})", all), "");
}

TEST_F(Metrics, OmitAccountStatesThatCannotBeRead)
{
    machine::remove("/etc/shadow");
    auto const all = lines();
    EXPECT_EQ(valueOf("mi_users", all), "7");
    EXPECT_EQ(valueOf("mi_accounts_disabled", all), "");
    EXPECT_EQ(valueOf("mi_accounts_expired", all), "");
    EXPECT_EQ(valueOf(R"(mi_doctor_ok{need="passwords in /etc/shadow"})", all), "0");
}

TEST_F(Metrics, IncludeTheDoctorsFindingsAboutTheMachine)
{
    machine::remove("/usr/sbin/userdel");
    auto const all = lines();
    EXPECT_EQ(valueOf(R"(mi_doctor_ok{need="command wc"})", all), "1");
    EXPECT_EQ(valueOf(R"(mi_doctor_ok{need="command /usr/sbin/userdel"})", all), "0");
    EXPECT_EQ(valueOf(R"(mi_doctor_fixable{need="command /usr/sbin/userdel"})", all), "1");
    EXPECT_EQ(valueOf(R"(mi_doctor_fixable{need="command wc"})", all), "");
    EXPECT_EQ(valueOf("mi_doctor_ok{need=\"root's privileges\"}", all), "");
}

TEST_F(Metrics, AreWrittenToAFile)
{
    std::filesystem::current_path("/tmp");
    Outcome const outcome = mihostRun({"metrics", "--output", "mi.prom"});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(valueOf("mi_users", mihost::linesOf(mihost::contentOf("/tmp/mi.prom"))), "7");
}

TEST_F(Metrics, ReportATreeThatCannotBeRead)
{
    Outcome const outcome = mihostRun({"--plugin", "/none", "metrics", "--output", "/tmp/mi.prom"});
    EXPECT_EQ(outcome.code, 3);
    EXPECT_TRUE(holds(outcome.err, "cannot load the plug-in '/none'"));
    auto const all = mihost::linesOf(mihost::contentOf("/tmp/mi.prom"));
    EXPECT_EQ(valueOf("mi_collection_success", all), "0");
    EXPECT_EQ(valueOf("mi_users", all), "");
}

TEST_F(Metrics, ReportAFileThatCannotBeWritten)
{
    EXPECT_EQ(mihostRun({"metrics", "--output", "/none/mi.prom"}),
              failed(2, "writing the metrics '/none/mi.prom': No such file or directory"));
}

} // namespace metrics_test
