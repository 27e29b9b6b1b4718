#include "engine/shape_note.h"

#include <variant>

#include "engine/report_text.h"

namespace ryn {

namespace {

std::string BoundText(double bound) {
    return "upper bound at " + SixDigits(bound);
}

// Half of the literature writes this shape with the other sign, so that both are given.
std::string HoskingNote(double kappa, double bound) {
    const std::string text =
        "kappa has Hosking's sign (shape in Coles (2001): " + SixDigits(kappa == 0 ? 0.0 : -kappa) +
        "): ";
    if (kappa == 0)
        return text + "the limit between heavy tails and upper bounds";
    return text + (kappa > 0 ? BoundText(bound) : "heavy tail, no upper bound");
}

std::string NoteOf(const stats::Gev& d) {
    return HoskingNote(d.Values().kappa, d.Support().upper);
}

std::string NoteOf(const stats::GeneralisedPareto& d) {
    return HoskingNote(d.Values().kappa, d.Support().upper);
}

std::string NoteOf(const stats::Weibull& d) {
    const double kappa = d.Values().kappa;
    return std::string("kappa > 1: tail lighter than exponential, kappa < 1: heavier; here ") +
           (kappa > 1   ? "lighter"
            : kappa < 1 ? "heavier"
                        : "exponential") +
           ", no upper bound";
}

std::string NoteOf(const stats::Frechet& d) {
    return "kappa is the tail's power: 1 - F falls like x^-kappa (a GEV of shape " +
           SixDigits(-1 / d.Values().kappa) + " in Hosking's sign)";
}

// The bound of a negative alpha is what people overlook.
template <class D>
std::string PearsonNote(const D& d) {
    return std::string("alpha has the sign of the skewness, whose size is 2/sqrt(kappa): ") +
           (d.Values().alpha > 0 ? "no upper bound" : BoundText(d.Support().upper));
}

std::string NoteOf(const stats::PearsonThree& d) {
    return PearsonNote(d);
}

std::string NoteOf(const stats::LogPearsonThree& d) {
    return "of the logarithms, " + PearsonNote(d);
}

// Families without a shape, and those whose parameters have one meaning in all books.
template <class D>
std::string NoteOf(const D& /*other*/) {
    return {};
}

} // namespace

std::string ShapeNote(const stats::Distribution& distribution) {
    return std::visit([](const auto& d) { return NoteOf(d); }, distribution);
}

} // namespace ryn
