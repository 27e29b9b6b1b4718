#include "strings/language.h"

#include <atomic>
#include <cstdlib>

namespace ryn {

namespace {

std::atomic<Language> current{Language::English};

} // namespace

Language CurrentLanguage() {
    return current.load();
}

void SetLanguage(Language language) {
    current.store(language);
}

Language LanguageOfLocale(std::string_view localeName) {
    const std::string_view code = localeName.substr(0, localeName.find_first_of("_.@"));
    return code == "ja" ? Language::Japanese : Language::English;
}

Language LanguageOfEnvironment() {
    for (const char* name : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        const char* const value = std::getenv(name);
        if (value != nullptr && *value != '\0')
            return LanguageOfLocale(value);
    }
    return Language::English;
}

} // namespace ryn
