#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include <CLI/App.hpp>

#include "apps/cli/case_arguments.h"
#include "apps/cli/console.h"

/// Options that several commands share, with the same names and the same help.
namespace ryn::cli {

/// --lang, whose value is looked up before the command line is made (its texts have a language).
void AddLanguageOption(CLI::App& command);
/// --yes
void AddConsentOption(CLI::App& command, Consent* consent);
/// --json
void AddJsonOption(CLI::App& command, OutputForm* form);
/// CASE.ryn
void AddCaseFileArgument(CLI::App& command, std::string* file);
/// Section.Keyword=value..., --fit and --periods
void AddCaseArguments(CLI::App& command, CaseArguments* arguments);
/// A required positional argument.
void AddFileArgument(CLI::App& command, const std::string& shownName, int helpTextId,
                     std::string* file);

/// An option with a value, named in help by `valueName`.
struct ValueOption {
    std::string names;
    std::string valueName;
    int helpTextId;
};
void AddTextOption(CLI::App& command, const ValueOption& option, std::optional<std::string>* value);
void AddPlainTextOption(CLI::App& command, const ValueOption& option, std::string* value);
/// A count from 0.
void AddCountOption(CLI::App& command, const ValueOption& option, long* value);
/// Bytes, as ParseSize takes them.
void AddSizeOption(CLI::App& command, const ValueOption& option, std::size_t* bytes);
/// A whole number of at least `least`.
void AddIntOption(CLI::App& command, const ValueOption& option, int least,
                  std::optional<int>* value);
/// A finite number with a decimal point, whatever the locale.
void AddNumberOption(CLI::App& command, const ValueOption& option, std::optional<double>* value);

/// Whether a choice may also be typed as its number, from 0.
enum class ChoiceNumbers { Taken, NotTaken };

/// The values that an option can have.
struct Choices {
    std::span<const std::string_view> names; ///< stay the caller's; taken in any case
    ChoiceNumbers numbers = ChoiceNumbers::Taken;
};
/// One of several values; `store` gets its number.
void AddChoiceOption(CLI::App& command, const ValueOption& option, const Choices& choices,
                     std::function<void(int)> store);
/// One that may be given several times; each takes one value.
void AddListOption(CLI::App& command, const ValueOption& option, std::vector<std::string>* values);

} // namespace ryn::cli
