#include "apps/cli/parse_error_text.h"

#include <vector>

#include "apps/cli/nearest_names.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// The option that an error is about: the one that its text names first. The errors carry nothing
/// but their text, which stays English.
const CLI::Option* OptionOf(const CLI::ParseError& error, const CLI::App& command) {
    const std::string text = error.what();
    const CLI::Option* found = nullptr;
    std::size_t place = std::string::npos;
    for (const CLI::Option* const option : command.get_options()) {
        const std::string name = option->get_name();
        const std::size_t at = text.find(name);
        const bool isLonger = found != nullptr && name.size() > found->get_name().size();
        if (at < place || (at == place && at != std::string::npos && isLonger)) {
            found = option;
            place = at;
        }
    }
    return found;
}

std::string Joined(const std::vector<std::string>& words) {
    std::string text;
    for (const std::string& word : words)
        text += (text.empty() ? "" : " ") + word;
    return text;
}

/// Of a command that something is left over of.
std::string UnexpectedText(const CLI::App& command) {
    const std::vector<std::string> arguments = command.remaining();
    const std::string text = FormatText(kTextCliUnexpectedArguments, Joined(arguments));
    std::vector<std::string> names;
    for (const CLI::Option* const option : command.get_options())
        names.push_back(option->get_name());
    const std::vector<std::string> nearest = NearestNames(arguments.front(), names);
    return nearest.empty() ? text : text + FormatText(kTextCliNearest, JoinNames(nearest));
}

} // namespace

std::string ParseErrorText(const CLI::ParseError& error, const CLI::App& command) {
    // A refused value was told in the user's language where it was refused.
    if (dynamic_cast<const CLI::ValidationError*>(&error) != nullptr)
        return error.what();
    const bool isUnexpected = dynamic_cast<const CLI::ExtrasError*>(&error) != nullptr;
    const CLI::Option* const option = isUnexpected ? nullptr : OptionOf(error, command);
    if (option == nullptr)
        return command.remaining().empty() ? error.what() : UnexpectedText(command);
    const std::string name = option->get_name();
    if (dynamic_cast<const CLI::RequiredError*>(&error) != nullptr)
        return FormatText(kTextCliArgumentMissing, name);
    if (dynamic_cast<const CLI::ArgumentMismatch*>(&error) != nullptr)
        return FormatText(option->count() > 1 ? kTextCliGivenTwice : kTextCliValueMissing, name);
    if (dynamic_cast<const CLI::ConversionError*>(&error) != nullptr)
        return FormatText(kTextCliNoSuchValue, name, Joined(option->results()));
    return error.what();
}

} // namespace ryn::cli
