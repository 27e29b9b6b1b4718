#include "controls/text_plot.h"

#include <string_view>

namespace ryn {

void CQxTextOcxPlot::ExportData(KvfTree* file) const {
    std::string_view rest = text;
    while (!rest.empty()) {
        const std::size_t end = rest.find('\n');
        kvfPutParam(file, "Line", rest.substr(0, end));
        rest.remove_prefix(end == std::string_view::npos ? rest.size() : end + 1);
    }
}

} // namespace ryn
