#include "apps/cli/command_options.h"

#include <cmath>

#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string TextOf(int id) {
    return std::string(Text(id));
}

[[noreturn]] void Refuse(const std::string& option, const std::string& value, int expectedTextId) {
    // CLI11 takes a refusal as an exception of its own, which ends at the parse.
    throw CLI::ValidationError(FormatText(kTextCliBadValue, option, value, TextOf(expectedTextId)));
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

void AddListOption(CLI::App& command, const ValueOption& option, std::vector<std::string>* values) {
    command.add_option(option.names, *values, TextOf(option.helpTextId))
        ->type_name(option.valueName)
        ->expected(1)
        ->allow_extra_args(false)
        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
}

} // namespace ryn::cli
