#include "mihost/cli/plugin/Redaction.h"

#include <gtest/gtest.h>

namespace redaction_test
{

using mihost::RedactingSink;
using mihost::withoutSecrets;

TEST(WithoutSecrets, ReplacesEachSecretThatIsAWord)
{
    EXPECT_EQ(withoutSecrets("/usr/sbin/usermod -p geheim jdoe 2>&1", {"geheim"}),
              "/usr/sbin/usermod -p (hidden) jdoe 2>&1");
    EXPECT_EQ(withoutSecrets("invalid 'geheim'\ngeheim\n", {"geheim"}),
              "invalid '(hidden)'\n(hidden)\n");
    EXPECT_EQ(withoutSecrets("/usr/sbin/usermod -p u u", {"u"}),
              "/usr/sbin/usermod -p (hidden) (hidden)");
    EXPECT_EQ(withoutSecrets("-p \\$6\\$a $6$a plain", {"plain", "$6$a", "\\$6\\$a"}),
              "-p (hidden) (hidden) (hidden)");
    EXPECT_EQ(withoutSecrets("a  b\n\nc ", {}), "a  b\n\nc ");
    EXPECT_EQ(withoutSecrets("a  b\n\nc ", {"x"}), "a  b\n\nc ");
    EXPECT_EQ(withoutSecrets("a  b", {""}), "a  b");
}

class Texts : public mihost::LogSink
{
public:
    void write(mihost::LogMessage const& message) override
    {
        all.push_back(message.text);
    }

    std::vector<std::string> all;
};

TEST(RedactingSink, RemovesSecretsWhileTheyAreHidden)
{
    Texts texts;
    RedactingSink sink(texts);
    std::string const category = "Category";
    std::string const text = "outputBuffer: geheim";
    auto const log = [&] {
        sink.write(
            {mihost::LogMessage::Operation::Log, "f", "F", 1, category, 3000, nullptr, 0, 0, text});
    };
    log();
    {
        RedactingSink::Hiding const hiding({"geheim"});
        log();
    }
    log();
    EXPECT_EQ(texts.all, (std::vector<std::string>{text, "outputBuffer: (hidden)", text}));
}

} // namespace redaction_test
