#ifndef MIHOST_CLI_INPUT_COMMANDLINE_H
#define MIHOST_CLI_INPUT_COMMANDLINE_H

#include "mihost/cli/input/Command.h"
#include "mihost/cli/input/Options.h"

namespace mihost
{

/** The arguments, taken apart. */
class CommandLine
{
public:
    /** The shell does not offer the options that determine how the plug-in is loaded. */
    enum class Place { Program, Shell };

    /** @param table  the commands to know; must outlive this */
    explicit CommandLine(CommandTable const& table, Place place = Place::Program,
                         Options const& defaults = {});

    /** Adds all options and commands, bound to this object. */
    void declare(CLI::App& app);

    /** The words that a declared option or argument takes; null if it takes any. */
    Choices const* choicesOf(CLI::Option const& option) const;

    /** @throws Failure (BadUsage) */
    void parse(std::vector<std::string> words);

    Options const& options() const
    {
        return options_;
    }

    /** The command to run; null for help or the version. */
    Command* command() const
    {
        return command_;
    }

    /** The requested help or version. */
    std::string const& answer() const
    {
        return answer_;
    }

private:
    struct Declared {
        CommandRow const* row;
        std::unique_ptr<Command> command;
    };

    void declareForProgram(CLI::App& app);
    void declareCommands(CLI::App& app);
    void choose(std::string const& name);
    void declareOutput(CLI::App& app);
    void setFormat(Format format);

    CommandTable const& table_;
    Place place_;
    Options options_;
    bool isFormatGiven_ = false; // on this line, not when the shell was started
    ChoiceTable choices_;        // of the options that hold for all commands
    std::vector<Declared> all_;
    std::vector<std::string> helpWords_;
    Command* command_ = nullptr;
    std::string answer_;
};

} // namespace mihost

#endif
