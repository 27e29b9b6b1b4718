#include "apps/cli/kvf_listing.h"

#include <ostream>
#include <string>

#include "apps/cli/plain_text.h"
#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string ParameterText(const KvfParam& parameter) {
    switch (kvfParamType(parameter)) {
    case KvfType::Int:
        return std::to_string(kvfParamInt(parameter));
    case KvfType::Float:
        return ShortestText(kvfParamFloat(parameter));
    case KvfType::Double:
        return ShortestText(kvfParamDouble(parameter));
    case KvfType::Bool:
        return kvfGetBool(&parameter) ? "true" : "false";
    case KvfType::Text:
    case KvfType::FileName:
        return '"' + PlainLine(kvfParamText(parameter)) + '"';
    }
    return {};
}

class TreePrinter : public KvfVisitor {
  public:
    explicit TreePrinter(std::ostream& stream) : out(stream) {}

    void BeginSection(std::string_view name) override {
        out << indent << PlainLine(name) << '\n';
        indent += "  ";
    }
    void EndSection() override { indent.resize(indent.size() - 2); }
    void BeginKeyword(std::string_view name, int parameterCount) override {
        // A column of values is easier to read than values behind names of all lengths.
        constexpr std::size_t kColumn = 32;
        line = indent + PlainLine(name);
        line.resize(std::max(line.size() + 1, kColumn), ' ');
        count = parameterCount;
        shown = 0;
    }
    void Parameter(const KvfParam& parameter) override {
        if (shown < kMostShown)
            line += (shown == 0 ? " " : ", ") + ParameterText(parameter);
        ++shown;
    }
    void EndKeyword() override {
        if (count > kMostShown)
            line += FormatText(kTextCliListLength, count);
        line.erase(line.find_last_not_of(' ') + 1);
        out << line << '\n';
    }

  private:
    static constexpr int kMostShown = 8;

    std::ostream& out;
    std::string indent;
    std::string line;
    int count = 0;
    int shown = 0;
};

} // namespace

void PrintTree(std::ostream& out, const KvfTree* tree) {
    TreePrinter printer(out);
    kvfVisit(tree, printer);
}

} // namespace ryn::cli
