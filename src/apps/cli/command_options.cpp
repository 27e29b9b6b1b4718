#include "apps/cli/command_options.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "apps/cli/nearest_names.h"
#include "apps/cli/size_text.h"
#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string TextOf(int id) {
    return std::string(Text(id));
}

[[noreturn]] void Refuse(const std::string& option, const std::string& value,
                         const std::string& expected) {
    // CLI11 takes a refusal as an exception of its own, which ends at the parse.
    throw CLI::ValidationError(FormatText(kTextCliBadValue, option, value, expected));
}

[[noreturn]] void Refuse(const std::string& option, const std::string& value, int expectedTextId) {
    Refuse(option, value, TextOf(expectedTextId));
}

bool IsSameInAnyCase(std::string_view a, std::string_view b) {
    const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; };
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [lower](char x, char y) { return lower(x) == lower(y); });
}

std::optional<int> ChoiceOf(std::string_view text, const Choices& choices) {
    const std::optional<int> number =
        choices.numbers == ChoiceNumbers::Taken ? ParseInt(text) : std::nullopt;
    for (std::size_t i = 0; i < choices.names.size(); ++i)
        if (number == static_cast<int>(i) || IsSameInAnyCase(text, choices.names[i]))
            return static_cast<int>(i);
    return std::nullopt;
}

/// "none, montecarlo", or "0 Weibull, 1 Hazen".
std::string ChoiceList(const Choices& choices) {
    std::vector<std::string> names;
    for (const std::string_view name : choices.names)
        names.push_back(choices.numbers == ChoiceNumbers::Taken
                            ? std::to_string(names.size()) + ' ' + std::string(name)
                            : std::string(name));
    return JoinNames(names);
}

} // namespace

void AddLanguageOption(CLI::App& command) {
    command
        .add_option_function<std::string>(
            "--lang",
            [](const std::string& language) {
                if (language != "en" && language != "ja")
                    Refuse("--lang", language, kTextCliExpectLanguage);
            },
            TextOf(kTextCliHelpLanguage))
        ->type_name("en|ja");
}

void AddConsentOption(CLI::App& command, Consent* consent) {
    command.add_flag_callback(
        "--yes", [consent] { *consent = Consent::Given; }, TextOf(kTextCliHelpYes));
}

void AddJsonOption(CLI::App& command, OutputForm* form) {
    command.add_flag_callback(
        "--json", [form] { *form = OutputForm::Json; }, TextOf(kTextCliHelpJson));
}

void AddFileArgument(CLI::App& command, const std::string& shownName, int helpTextId,
                     std::string* file) {
    command.add_option(shownName, *file, TextOf(helpTextId))->required()->type_name("");
}

void AddCaseFileArgument(CLI::App& command, std::string* file) {
    AddFileArgument(command, "CASE.ryn", kTextCliHelpCaseFile, file);
}

void AddCaseArguments(CLI::App& command, CaseArguments* arguments) {
    command
        .add_option("Section.Keyword=value", arguments->assignments,
                    TextOf(kTextCliHelpAssignments))
        ->type_name("");
    AddListOption(command, {"--fit", "NAME", kTextCliHelpFitNames}, &arguments->fits);
    AddTextOption(command, {"--periods", "2,10,100", kTextCliHelpPeriods}, &arguments->periods);
}

void AddTextOption(CLI::App& command, const ValueOption& option,
                   std::optional<std::string>* value) {
    command
        .add_option_function<std::string>(
            option.names, [value](const std::string& text) { *value = text; },
            TextOf(option.helpTextId))
        ->type_name(option.valueName);
}

void AddPlainTextOption(CLI::App& command, const ValueOption& option, std::string* value) {
    command.add_option(option.names, *value, TextOf(option.helpTextId))
        ->type_name(option.valueName);
}

void AddCountOption(CLI::App& command, const ValueOption& option, long* value) {
    const std::string name = option.names;
    command
        .add_option_function<std::string>(
            option.names,
            [value, name](const std::string& text) {
                const std::optional<int> count = ParseInt(text);
                if (!count || *count < 0)
                    Refuse(name, text, kTextCliExpectInt);
                *value = *count;
            },
            TextOf(option.helpTextId))
        ->type_name(option.valueName);
}

void AddSizeOption(CLI::App& command, const ValueOption& option, std::size_t* bytes) {
    const std::string name = option.names;
    command
        .add_option_function<std::string>(
            option.names,
            [bytes, name](const std::string& text) {
                const std::optional<std::size_t> size = ParseSize(text);
                if (!size)
                    Refuse(name, text, kTextCliExpectSize);
                *bytes = *size;
            },
            TextOf(option.helpTextId))
        ->type_name(option.valueName);
}

void AddIntOption(CLI::App& command, const ValueOption& option, int least,
                  std::optional<int>* value) {
    const std::string name = option.names;
    command
        .add_option_function<std::string>(
            option.names,
            [value, name, least](const std::string& text) {
                *value = ParseInt(text);
                if (!*value || **value < least)
                    Refuse(name, text, kTextCliExpectInt);
            },
            TextOf(option.helpTextId))
        ->type_name(option.valueName);
}

void AddNumberOption(CLI::App& command, const ValueOption& option, std::optional<double>* value) {
    const std::string name = option.names;
    command
        .add_option_function<std::string>(
            option.names,
            [value, name](const std::string& text) {
                *value = ParseDouble(text);
                if (!*value || !std::isfinite(**value))
                    Refuse(name, text, kTextCliExpectNumber);
            },
            TextOf(option.helpTextId))
        ->type_name(option.valueName);
}

void AddChoiceOption(CLI::App& command, const ValueOption& option, const Choices& choices,
                     std::function<void(int)> store) {
    const std::string name = option.names;
    command
        .add_option_function<std::string>(
            option.names,
            [choices, store = std::move(store), name](const std::string& text) {
                const std::optional<int> choice = ChoiceOf(text, choices);
                if (!choice)
                    Refuse(name, text, ChoiceList(choices));
                store(*choice);
            },
            TextOf(option.helpTextId))
        ->type_name(option.valueName);
}

void AddListOption(CLI::App& command, const ValueOption& option, std::vector<std::string>* values) {
    command.add_option(option.names, *values, TextOf(option.helpTextId))
        ->type_name(option.valueName)
        ->expected(1)
        ->allow_extra_args(false)
        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
}

} // namespace ryn::cli
