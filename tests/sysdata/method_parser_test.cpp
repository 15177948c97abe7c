#include "sysdata/osInfo_linux.h"

#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <type_traits>
#include <utility>
#include <vector>

namespace method_parser_test
{

using NQ::ParamInfo;

/** The outcome of one parse; method and parameters are unchanged if nothing was set. */
struct Parsed {
    explicit Parsed(std::string const& text)
    {
        std::vector<ParamInfo> list;
        status = NQ::OsInfo().parseMethodAndParams(text, method, list);
        for (ParamInfo const& param : list)
            params.push_back(param.name + "|" + param.type + "|" + param.value);
    }

    int status;
    std::string method = "(as it was)";
    Lines params;
};

/** What the parser itself logs about a text, entry and exit included. */
Lines said(std::string const& text)
{
    Recording const log;
    Parsed const parsed(text);
    Lines found;
    for (LogRecord const& record : log.records())
        if (!record.trace && record.function == "parseMethodAndParams")
            found.push_back(record.text);
    return found;
}

Lines inside(Lines texts)
{
    texts.insert(texts.begin(), "OsNode::parseMethodAndParams: entry");
    texts.emplace_back("OsNode::parseMethodAndParams: exit");
    return texts;
}

std::string dateOf(std::string const& value)
{
    Parsed const parsed("UserSetAttrib,passwordExpirationDate:CMPI_dateTime:" + value);
    EXPECT_EQ(parsed.status, 0);
    return parsed.params.empty() ? "(none)" : parsed.params.front();
}

TEST(ParamInfo, IsAValueOfThreeTexts)
{
    ParamInfo const first{"UserName", "CMPI_string", "jdoe"};
    ParamInfo second = first;
    second.value = "other";
    EXPECT_EQ(first.name + first.type + first.value, "UserNameCMPI_stringjdoe");
    EXPECT_EQ(second.value, "other");
    EXPECT_TRUE(std::is_copy_constructible_v<ParamInfo>);
}

TEST(MethodParser, SplitsATextIntoTheMethodAndItsParameters)
{
    struct {
        char const* what;
        char const* text;
        char const* method;
        Lines params;
    } const cases[] = {
        {"texts",
         "UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:Test",
         "UserAdd",
         {"UserName|CMPI_string|jdoe", "Comment|CMPI_string|Test"}},
        {"a date",
         "UserSetAttrib,UserName:CMPI_string:jdoe,passwordExpirationDate:"
         "CMPI_dateTime:20101231000000.000000+000",
         "UserSetAttrib",
         {"UserName|CMPI_string|jdoe", "passwordExpirationDate|CMPI_dateTime|2010-12-31"}},
        {"no parameters", "UserDel", "UserDel", {}},
        {"empty items",
         "UserAdd,,UserName:CMPI_string:jdoe,",
         "UserAdd",
         {"UserName|CMPI_string|jdoe"}},
        {"empty parts",
         ",UserAdd,:UserName::CMPI_string:::jdoe:",
         "UserAdd",
         {"UserName|CMPI_string|jdoe"}},
        {"a colon in the method", "User:Add:x", "User:Add:x", {}},
        {"parts beyond the third",
         "UserAdd,Comment:CMPI_string:12:30",
         "UserAdd",
         {"Comment|CMPI_string|12"}},
        {"a number that is a text",
         "UserSetAttrib,daysExpireAfter:CMPI_uint32:soon",
         "UserSetAttrib",
         {"daysExpireAfter|CMPI_uint32|soon"}},
        {"a blank number",
         "UserSetAttrib,daysExpireAfter:CMPI_uint32,UserName:CMPI_string:jdoe",
         "UserSetAttrib",
         {}},
        {"a quoted colon",
         "UserAdd,Comment:CMPI_string:\"a:b\"",
         "UserAdd",
         {"Comment|CMPI_string|\"a"}},
        {"an escaped comma",
         "UserAdd,Comment:CMPI_string:a\\,Colour:CMPI_string:b",
         "UserAdd",
         {"Comment|CMPI_string|a\\", "Colour|CMPI_string|b"}},
        {"a quoted comma",
         "UserAdd,Comment:CMPI_string:\"a,Colour:CMPI_string:b\"",
         "UserAdd",
         {"Comment|CMPI_string|\"a", "Colour|CMPI_string|b\""}},
    };
    for (auto const& [what, text, method, params] : cases) {
        Parsed const parsed(text);
        EXPECT_EQ(parsed.status, 0) << what;
        EXPECT_EQ(parsed.method, method) << what;
        EXPECT_EQ(parsed.params, params) << what;
    }
    EXPECT_EQ(said("UserDel"), inside({"method=UserDel"}));
}

TEST(MethodParser, KeepsTheMethodIfThereAreNoItems)
{
    for (char const* text : {"", ",", ",,,"}) {
        Parsed const parsed(text);
        EXPECT_EQ(parsed.status, 0);
        EXPECT_EQ(parsed.method, "(as it was)");
        EXPECT_EQ(parsed.params, Lines());
        EXPECT_EQ(said(text), inside({}));
    }
}

TEST(MethodParser, AcceptsEveryByteButTheSeparatorsInAValue)
{
    std::string value;
    for (int byte = 1; byte < 256; ++byte)
        if (byte != ',' && byte != ':')
            value += static_cast<char>(byte);
    for (std::string const lead : {"", "Password:CMPI_string:s,"}) {
        Parsed const parsed("UserAdd," + lead + "Comment:CMPI_string:" + value);
        EXPECT_EQ(parsed.status, 0);
        EXPECT_EQ(parsed.params.back(), "Comment|CMPI_string|" + value);
    }
}

TEST(MethodParser, AppendsToTheList)
{
    std::string method;
    std::vector<ParamInfo> params{{"before", "CMPI_string", "x"}};
    NQ::OsInfo().parseMethodAndParams("UserDel,UserName:CMPI_string:jdoe", method, params);
    ASSERT_EQ(params.size(), 2U);
    EXPECT_EQ(params[0].name, "before");
    EXPECT_EQ(params[1].name, "UserName");
}

TEST(MethodParser, StopsQuietlyAtABlankTextOrNumber)
{
    for (std::string const type : {"CMPI_string", "CMPI_uint32"}) {
        std::string const text = "UserAdd,UserName:CMPI_string:jdoe,Comment:" + type +
                                 ":,HomeDir:CMPI_string:/home/jdoe";
        Parsed const parsed(text);
        EXPECT_EQ(parsed.status, 0);
        EXPECT_EQ(parsed.method, "UserAdd");
        EXPECT_EQ(parsed.params, Lines{"UserName|CMPI_string|jdoe"});
        Recording const log;
        EXPECT_EQ(said(text),
                  inside({"method=UserAdd", "paramInfo.name=UserName", "paramInfo.type=CMPI_string",
                          "paramInfo.value=jdoe", "paramInfo.name=Comment",
                          "paramInfo.type=" + type, "This parameter is blank ---exiting "}));
        EXPECT_EQ(log.texts(6000), Lines());
    }
}

TEST(MethodParser, TreatsAnItemThatIsNotAParameterAsBlank)
{
    for (char const* item : {"Comment", "Comment:", "::", ":"}) {
        std::string const text =
            std::string("UserAdd,UserName:CMPI_string:jdoe,") + item + ",HomeDir:CMPI_string:/h";
        Parsed const parsed(text);
        EXPECT_EQ(parsed.status, 0) << item;
        EXPECT_EQ(parsed.params, Lines{"UserName|CMPI_string|jdoe"}) << item;
        EXPECT_EQ(said(text),
                  inside({"method=UserAdd", "paramInfo.name=UserName", "paramInfo.type=CMPI_string",
                          "paramInfo.value=jdoe", "This parameter is blank ---exiting "}))
            << item;
    }
}

TEST(MethodParser, ContinuesAfterABlankDate)
{
    std::string const text = "UserSetAttrib,passwordExpirationDate:CMPI_dateTime:,"
                             "UserName:CMPI_string:jdoe";
    Parsed const parsed(text);
    EXPECT_EQ(parsed.status, 0);
    EXPECT_EQ(parsed.params,
              (Lines{"passwordExpirationDate|CMPI_dateTime|", "UserName|CMPI_string|jdoe"}));
    EXPECT_EQ(said(text), inside({"method=UserSetAttrib", "paramInfo.name=passwordExpirationDate",
                                  "paramInfo.type=CMPI_dateTime", "paramInfo.name=UserName",
                                  "paramInfo.type=CMPI_string", "paramInfo.value=jdoe"}));
}

TEST(MethodParser, LogsTheConvertedDate)
{
    EXPECT_EQ(said("UserSetAttrib,passwordExpirationDate:CMPI_dateTime:20100507000000.000000+000"),
              inside({"method=UserSetAttrib", "paramInfo.name=passwordExpirationDate",
                      "paramInfo.type=CMPI_dateTime", "paramInfo.value=2010-5-7"}));
}

TEST(MethodParser, RejectsAnUnreadableDateAndKeepsTheRest)
{
    for (std::string const date :
         {"soon", "2010-12-31", "20101231", "20101231000000", "20101231000000.000000",
          "20101231000000.000000+", "20101231000000.000000*000", "2010123.000000+000",
          "20101231000000.000000 +060", "201012310000000.000000+000", "201012310000000.000000-000",
          "20101231000000.0000000+000", "20101231000000.0000000-000"}) {
        std::string const text = "UserAdd,UserName:CMPI_string:jdoe,passwordExpirationDate:"
                                 "CMPI_dateTime:" +
                                 date + ",Comment:CMPI_string:Test";
        Parsed const parsed(text);
        EXPECT_EQ(parsed.status, 1) << date;
        EXPECT_EQ(parsed.method, "UserAdd");
        EXPECT_EQ(parsed.params, Lines{"UserName|CMPI_string|jdoe"});
        EXPECT_EQ(said(text),
                  inside({"method=UserAdd", "paramInfo.name=UserName", "paramInfo.type=CMPI_string",
                          "paramInfo.value=jdoe", "paramInfo.name=passwordExpirationDate",
                          "paramInfo.type=CMPI_dateTime"}));
    }
}

TEST(MethodParser, RejectsAnUnknownTypeAndKeepsEarlierParameters)
{
    for (std::string const type :
         {"CMPI_boolean", "CMPI_String", "CMPI_string8", "CMPI_datetime", "string"})
        for (std::string const end : {"", ":true,Comment:CMPI_string:Test"}) {
            Recording const log;
            Parsed const parsed("UserAdd,UserName:CMPI_string:jdoe,Active:" + type + end);
            EXPECT_EQ(parsed.status, 1) << type;
            EXPECT_EQ(parsed.params, Lines{"UserName|CMPI_string|jdoe"}) << type;
            EXPECT_EQ(log.texts(6000), Lines{"Unknown parameter type: " + type});
            EXPECT_EQ(log.texts().back(), "OsNode::parseMethodAndParams: exit");
        }
}

TEST(MethodParser, LogsUnderItsUnitAndCategory)
{
    Recording const log;
    Parsed const parsed("UserAdd,Active:CMPI_boolean:true");
    int seen = 0;
    for (LogRecord const& record : log.records()) {
        if (record.function != "parseMethodAndParams")
            continue;
        ++seen;
        EXPECT_EQ(record.file, "osInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.OsInfo");
    }
    EXPECT_EQ(seen, 2 * 6); // entry, method, name, type, complaint, exit
}

TEST(MethodParser, TokenizesTheTextAndThenEachItem)
{
    Recording const log;
    Parsed const parsed("UserDel,UserName:CMPI_string:jdoe");
    EXPECT_EQ(
        log.texts(),
        inside({"Tokenize: entry", "str.substr(lastPos, pos - lastPos) = UserDel",
                "str.substr(lastPos, pos - lastPos) = UserName:CMPI_string:jdoe", "Tokenize: exit",
                "method=UserDel", "Tokenize: entry",
                "str.substr(lastPos, pos - lastPos) = UserName",
                "str.substr(lastPos, pos - lastPos) = CMPI_string",
                "str.substr(lastPos, pos - lastPos) = jdoe", "Tokenize: exit",
                "paramInfo.name=UserName", "paramInfo.type=CMPI_string", "paramInfo.value=jdoe"}));
}

TEST(MethodParser, ReadsDatesByTheTwoScanningFormats)
{
    for (auto const& [value, date] : {std::pair{"20100507123456.654321+120", "2010-5-7"},
                                      {"20101231000000.000000-060", "2010-12-31"},
                                      {"20101231000000.000000+060", "2010-12-31"},
                                      {"2010 1 2 3.4+5", "2010-1-2"},
                                      {"20101231000000.0-0", "2010-12-31"},
                                      {"20101231000000.000000+0609Z", "2010-12-31"},
                                      {"20101399999999.999999+999", "2010-13-99"},
                                      {"2010-1-2 3.4-5", "2010--1--2"}})
        EXPECT_EQ(dateOf(value), std::string("passwordExpirationDate|CMPI_dateTime|") + date);
}

} // namespace method_parser_test
