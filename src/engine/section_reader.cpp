#include "engine/section_reader.h"

namespace ryn {

namespace {

// By the type of a value, for whoever has the file in an editor.
constexpr const char* Wanted(int /*type*/) {
    return "is not a whole number";
}
constexpr const char* Wanted(bool /*type*/) {
    return "is neither true nor false";
}
constexpr const char* Wanted(double /*type*/) {
    return "is not a number";
}
const char* Wanted(const std::string& /*type*/) {
    return "is not a text";
}

} // namespace

SectionReader SectionReader::Inside(std::string_view child) const {
    return {kvfSectionByNameNum(section, child, 1), PathOf(child), *noted};
}

std::string SectionReader::PathOf(std::string_view keyword) const {
    return name + "/" + std::string(keyword);
}

template <typename Type>
Type SectionReader::Optional(const char* keyword, Type fallback) const {
    // The store takes a wrong type for nothing found. Here it must not pass for a keyword that an
    // older file lacks: the run would go on with something that nobody asked for.
    if (kvfGetParam(section, keyword, &fallback, 1, 1) == 0 && Has(keyword))
        Fault(keyword, Wanted(fallback));
    return fallback;
}

template <typename Type>
Type SectionReader::Required(const char* keyword) const {
    // A missing section has been told as such.
    if (section != nullptr && !Has(keyword))
        Fault(keyword, "is missing");
    return Optional(keyword, Type{});
}

void SectionReader::Fault(std::string_view keyword, std::string_view rest) const {
    noted->push_back(PathOf(keyword) + " " + std::string(rest));
}

// The types that the engine's input has.
template int SectionReader::Optional(const char*, int) const;
template bool SectionReader::Optional(const char*, bool) const;
template double SectionReader::Optional(const char*, double) const;
template std::string SectionReader::Optional(const char*, std::string) const;
template int SectionReader::Required(const char*) const;
template double SectionReader::Required(const char*) const;

} // namespace ryn
