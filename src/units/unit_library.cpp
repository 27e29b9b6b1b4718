#include "units/unit_library.h"

#include <clocale>
#include <cstdlib>
#include <string>

#include <udunits2.h>

namespace ryn {

namespace {

// UDUNITS reads numbers, those of its database too, by the C library and so by the locale: under
// one with a decimal comma "0.1 mm" would be another unit or none. The thread's locale is plain "C"
// while it works.
class PlainLocale {
  public:
    PlainLocale() : previous(::uselocale(Plain())) {}
    ~PlainLocale() { ::uselocale(previous); }
    PlainLocale(const PlainLocale&) = delete;
    PlainLocale& operator=(const PlainLocale&) = delete;

  private:
    static locale_t Plain() {
        static const locale_t plain = ::newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr));
        return plain;
    }

    locale_t previous;
};

Status LoadFault() {
    const char* const path = std::getenv("UDUNITS2_XML_PATH");
    const std::string place = path != nullptr ? path : "the installed file";
    return Status::SystemFault("the database of units cannot be loaded from " + place);
}

} // namespace

double UnitConverter::Convert(double value) const {
    return cv_convert_double(converter.get(), value);
}

void UnitConverter::Free::operator()(cv_converter* freed) const {
    cv_free(freed);
}

void UnitLibrary::FreeSystem::operator()(ut_system* freed) const {
    ut_free_system(freed);
}

void UnitLibrary::FreeUnit::operator()(ut_unit* freed) const {
    ut_free(freed);
}

UnitLibrary::UnitLibrary() {
    const PlainLocale plain;
    ut_set_error_message_handler(ut_ignore); // else every unknown text is a line on standard error
    system.reset(ut_read_xml(nullptr));
    if (!system)
        loaded = LoadFault();
}

UnitLibrary::~UnitLibrary() = default;

UnitLibrary::Unit UnitLibrary::Parse(std::string_view text) const {
    const PlainLocale plain;
    // A NUL would hide what stands behind it.
    if (!system || text.find('\0') != std::string_view::npos)
        return nullptr;
    return Unit(ut_parse(system.get(), std::string(text).c_str(), UT_UTF8));
}

bool UnitLibrary::Knows(std::string_view text) const {
    return Parse(text) != nullptr;
}

bool UnitLibrary::IsSame(std::string_view a, std::string_view b) const {
    const Unit first = Parse(a);
    const Unit second = Parse(b);
    return first && second && ut_compare(first.get(), second.get()) == 0;
}

std::optional<UnitConverter> UnitLibrary::Converter(std::string_view from,
                                                    std::string_view to) const {
    const Unit first = Parse(from);
    const Unit second = Parse(to);
    if (!first || !second)
        return std::nullopt;
    const PlainLocale plain;
    UnitConverter result;
    result.converter.reset(ut_get_converter(first.get(), second.get()));
    if (!result.converter)
        return std::nullopt;
    return result;
}

} // namespace ryn
