#pragma once

#include "cli/optionValues.h"

#include <CLI/CLI.hpp>

#include <iosfwd>
#include <string>
#include <utility>
#include <vector>

namespace Stillmark
{

/// The options of one subcommand, bound to the variables that receive them. Declare them, then parse.
class argumentParser
{
public:
    /// program: "stillmark suggest"; usage: what follows it in the first line of the help; about: what it does; footer:
    /// the last paragraph of the help. words: the arguments. Help and version are printed to helpOut.
    argumentParser(const std::string &program, const std::string &usage, const std::string &about,
                   const std::string &footer, std::vector<std::string> words, std::ostream &helpOut);

    void flag(const std::string &name, bool &target, const std::string &about);
    void positional(const std::string &name, std::string &target, const std::string &about);
    /// One or more.
    void positionals(const std::string &name, std::vector<std::string> &target, const std::string &about);
    void required(const std::string &name, const std::string &valueName, std::string &target, const std::string &about);

    /// An option with one value, which convert makes from its text.
    template <typename Target, typename Convert>
    CLI::Option *value(const std::string &name, const std::string &valueName, Target &target, const std::string &about,
                       Convert convert)
    {
        return app
            .add_option_function<std::string>(
                name,
                [&target, convert, name](const std::string &text) { target = convertOption(name, text, convert); },
                about)
            ->type_name(valueName);
    }

    template <typename Target, typename Convert>
    void required(const std::string &name, const std::string &valueName, Target &target, const std::string &about,
                  Convert convert)
    {
        value(name, valueName, target, about, convert)->required();
    }

    /// An option that may be given several times, with one value each time.
    template <typename Target, typename Convert>
    void values(const std::string &name, const std::string &valueName, std::vector<Target> &target,
                const std::string &about, Convert convert)
    {
        app.add_option_function<std::vector<std::string>>(
               name,
               [&target, convert, name](const std::vector<std::string> &texts) {
                   for (const std::string &text : texts)
                       target.push_back(convertOption(name, text, convert));
               },
               about)
            ->type_name(valueName)
            ->allow_extra_args(false); // or a photo after it would be taken for a second value
    }

    /// False if help or version was asked for and printed. Throws usageError.
    bool parse();

private:
    template <typename Convert>
    static auto convertOption(const std::string &name, const std::string &text, Convert convert)
    {
        try
        {
            return convert(text);
        }
        catch (const usageError &e)
        {
            throw usageError(name + ": " + e.what());
        }
    }

    CLI::App app;
    std::vector<std::string> arguments;
    std::ostream &out;
};

} // namespace Stillmark
