#include "cli/argumentParser.h"

#include <algorithm>
#include <memory>
#include <ostream>

namespace Stillmark
{
namespace
{

/// Help with a usage line of our own and without the words that the library puts after names.
class helpFormatter : public CLI::Formatter
{
public:
    explicit helpFormatter(std::string line) : usageLine(std::move(line))
    {
        column_width(33);
        label("Positionals", "Arguments");
    }

    std::string make_usage(const CLI::App *, std::string) const override { return "Usage: " + usageLine + "\n"; }
    std::string make_option_opts(const CLI::Option *option) const override
    {
        return option->get_type_name().empty() ? "" : " " + option->get_type_name();
    }

private:
    std::string usageLine;
};

} // namespace

argumentParser::argumentParser(const std::string &program, const std::string &usage, const std::string &about,
                               const std::string &footer, std::vector<std::string> words, std::ostream &helpOut)
    : app(about, program), arguments(std::move(words)), out(helpOut)
{
    app.formatter(std::make_shared<helpFormatter>(program + " " + usage));
    app.footer(footer);
    app.set_help_flag("-h,--help", "this text");
    if (!footer.empty())
        app.set_version_flag("--version", "stillmark " STILLMARK_VERSION, "the version");
}

void argumentParser::flag(const std::string &name, bool &target, const std::string &about)
{
    app.add_flag(name, target, about)->disable_flag_override();
}

void argumentParser::positional(const std::string &name, std::string &target, const std::string &about)
{
    app.add_option(name, target, about)->required()->type_name("");
}

void argumentParser::positionals(const std::string &name, std::vector<std::string> &target, const std::string &about)
{
    app.add_option(name, target, about)->required()->type_name("");
}

void argumentParser::required(const std::string &name, const std::string &valueName, std::string &target,
                              const std::string &about)
{
    required(name, valueName, target, about, [](const std::string &text) { return text; });
}

bool argumentParser::parse()
{
    try
    {
        std::reverse(arguments.begin(), arguments.end()); // the library takes them from the end
        app.parse(std::move(arguments));
        return true;
    }
    catch (const CLI::Success &asked)
    {
        app.exit(asked, out, out);
        return false;
    }
    catch (const CLI::ParseError &e)
    {
        throw usageError(e.what());
    }
}

} // namespace Stillmark
