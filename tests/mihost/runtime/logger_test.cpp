// The reference runtime's logger.

#include "host/VXLogger.h"

#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace logger_test
{

using VXLog::VXLogger;

TEST(Logger, PassesEveryArgumentOfBothCallsToTheSink)
{
    Recording const log;
    char extra[] = "extra";
    VXLogger::logLevelMessage("function", "file", 12, "category", 3000, nullptr, 0, 0, "text");
    VXLogger::traceLevelMessage("other", "unit", 34, "dotted.category", 6000, extra, 5, 6, "more");
    std::vector<LogRecord> const records = log.records();
    ASSERT_EQ(records.size(), 2U);
    EXPECT_FALSE(records[0].trace);
    EXPECT_EQ(records[0].function, "function");
    EXPECT_EQ(records[0].file, "file");
    EXPECT_EQ(records[0].line, 12);
    EXPECT_EQ(records[0].category, "category");
    EXPECT_EQ(records[0].level, 3000);
    EXPECT_TRUE(records[0].extraIsNull);
    EXPECT_EQ(records[0].first, 0);
    EXPECT_EQ(records[0].second, 0);
    EXPECT_EQ(records[0].text, "text");
    EXPECT_TRUE(records[1].trace);
    EXPECT_EQ(records[1].function, "other");
    EXPECT_EQ(records[1].file, "unit");
    EXPECT_EQ(records[1].line, 34);
    EXPECT_EQ(records[1].category, "dotted.category");
    EXPECT_EQ(records[1].level, 6000);
    EXPECT_FALSE(records[1].extraIsNull);
    EXPECT_EQ(records[1].first, 5);
    EXPECT_EQ(records[1].second, 6);
    EXPECT_EQ(records[1].text, "more");
}

TEST(Logger, DropsMessagesWithoutASink)
{
    Recording const log;
    mihost::setLogSink(nullptr);
    VXLogger::logLevelMessage("function", "file", 12, "category", 3000, nullptr, 0, 0, "text");
    VXLogger::traceLevelMessage("function", "file", 12, "category", 3000, nullptr, 0, 0, "text");
    EXPECT_TRUE(log.records().empty());
}

} // namespace logger_test
