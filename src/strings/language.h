#pragma once

#include <string_view>

namespace ryn {

enum class Language { English, Japanese };

/// The language of every text from the catalogue; one for the process, English at the start. It can
/// change at any time; texts already made stay as they are.
Language CurrentLanguage();
void SetLanguage(Language language);

/// The language of a locale name ("ja_JP.UTF-8", "ja"): Japanese for "ja", English for all others.
Language LanguageOfLocale(std::string_view localeName);

/// The language that the environment asks for: the first of LC_ALL, LC_MESSAGES, LANG that is set.
Language LanguageOfEnvironment();

} // namespace ryn
