#include "import/group_columns.h"

#include <algorithm>

#include "import/number_field.h"
#include "import/table_text.h"

namespace ryn {

namespace {

// In English, German, Dutch, French, Italian, Spanish, Portuguese, the Nordic languages and
// Japanese: places, rivers, measured quantities.
constexpr std::string_view kGroupWords =
    "series|station|stations|stn|sta|stationid|stationname|stationcode|site|siteid|sitename|"
    "location|"
    "messstelle|messstellenname|messstellennummer|stationsnummer|stationsname|stationskennung|"
    "standort|meetpunt|meetpuntcode|meetlocatie|locatie|lieu|poste|estación|estacion|sitio|"
    "stazione|sito|estação|estacao|stasjon|"
    "river|gewässer|gewaesser|fluss|rivière|riviere|rivier|río|rio|fiume|"
    "parameter|parametername|parametercode|param|variable|varname|element|datatype|messgröße|"
    "messgroesse|größe|grandeur|paramètre|parametre|grootheid|variabele|parámetro|parametro|"
    "magnitud|grandezza|variabile|variável|"
    "観測所|観測所名|観測所記号|観測所番号|観測点|地点|地点名|地点番号|局名|局番号|河川|河川名|"
    "水系|"
    "水系名|項目|要素|観測項目";

// These are levels as well, where they are numbers.
constexpr std::string_view kGaugeWords = "gauge|gage|pegel|pegelname|peilschaal|échelle";

// What may stand beside such a word, and tells little alone.
constexpr std::string_view kIdWords =
    "id|ids|identifier|no|nr|num|number|nummer|numero|número|"
    "code|cod|cd|file|name|nom|naam|nombre|nome|navn|namn|kennung|monitoring|"
    "measuring|der|de|des|du|la|del|名|名称|番号";

bool IsWordOf(const std::string& word, std::string_view list) {
    return IsOneOf(word, list);
}

} // namespace

GroupColumns::GroupColumns(const TableLayout& tableLayout) : layout(tableLayout) {
    for (std::size_t i = 0; i < layout.columns.size(); ++i) {
        const Naming naming = IsWatched(i) ? NamingOf(i) : Naming::None;
        if (naming == Naming::None)
            continue;
        columns.emplace_back();
        columns.back().index = i;
        columns.back().naming = naming;
    }
}

bool GroupColumns::IsWatched(std::size_t column) const {
    const auto holds = [column](const std::vector<std::size_t>& list) {
        return std::find(list.begin(), list.end(), column) != list.end();
    };
    const ColumnKind kind = layout.columns[column].kind;
    return (kind == ColumnKind::Text || kind == ColumnKind::Number) && !holds(layout.items) &&
           !holds(layout.months) &&
           std::none_of(layout.time.columns.begin(), layout.time.columns.end(),
                        [column](const TimeColumn& time) { return time.column == column; });
}

GroupColumns::Naming GroupColumns::NamingOf(std::size_t column) const {
    const bool isText = layout.columns[column].kind == ColumnKind::Text;
    // Flags stand behind the values that they qualify.
    const bool isInFront = column < layout.items.front();
    const std::vector<std::string> words = Words(layout.columns[column].name);
    if (words.empty())
        return isText && isInFront ? Naming::Perhaps : Naming::None;
    const auto isGroup = [isText](const std::string& word) {
        return IsWordOf(word, kGroupWords) || (isText && IsWordOf(word, kGaugeWords));
    };
    // Every word counts: a "station pressure" and a "site condition" are no names of places.
    const bool areKnown = std::all_of(words.begin(), words.end(), [&isGroup](const auto& word) {
        return isGroup(word) || IsWordOf(word, kIdWords);
    });
    if (!areKnown)
        return Naming::None;
    if (std::any_of(words.begin(), words.end(), isGroup))
        return Naming::Group;
    return isInFront ? Naming::Perhaps : Naming::None;
}

void GroupColumns::Add(long line, Millis moment, const std::vector<std::string_view>& fields) {
    for (Column& column : columns)
        if (column.index < fields.size())
            AddTo(&column, line, moment > previous, fields[column.index]);
    previous = moment;
}

void GroupColumns::AddTo(Column* column, long line, bool rises, std::string_view field) {
    // More groups change nothing, and a hostile table could fill the memory with them.
    constexpr std::size_t kMostGroups = 1000;
    constexpr std::size_t kLongestName = 200;
    if (column->isFull)
        return;
    field = field.substr(0, kLongestName);
    if (IsMissingWord(field)) {
        // A name in the first row alone holds for those below it.
        column->rows += column->naming == Naming::Group && !column->groups.empty() ? 1 : 0;
        return;
    }
    ++column->rows;
    if (!column->groups.empty() && column->groups[column->last].name == field)
        return; // nearly every row ends here
    const std::size_t before = column->groups.size();
    column->isFull = before == kMostGroups;
    const auto [at, isNew] = column->positions.try_emplace(std::string(field), before);
    if (isNew)
        column->groups.push_back({at->first, line});
    column->last = at->second;
    column->clashes += column->runs > 0 && !rises ? 1 : 0;
    ++column->runs;
}

bool GroupColumns::TellsSeriesApart(const Column& column) const {
    const auto groups = static_cast<long>(column.groups.size());
    if (groups < 2 || groups == column.rows) // another name in each row is the row's own
        return false;
    const bool isText = layout.columns[column.index].kind == ColumnKind::Text;
    if (column.naming == Naming::Group && isText)
        return true;
    // Numbers, and names that say little, need the rows' own proof: each series in one piece, or
    // times that begin anew.
    return 2 * groups <= column.rows && (column.runs == groups || column.clashes > 0);
}

Status GroupColumns::Check(const std::string& source) const {
    const auto at = std::find_if(columns.begin(), columns.end(),
                                 [this](const Column& column) { return TellsSeriesApart(column); });
    if (at == columns.end())
        return Status::Ok();
    const Group& first = at->groups[0];
    const Group& second = at->groups[1];
    const std::size_t count = at->groups.size();
    return Status::InputFault(
        source + ": line " + std::to_string(second.line) + ": " + Quoted(second.name) +
        " in column " + ColumnTitle(layout, at->index) + " is another series than " +
        Quoted(first.name) + " in line " + std::to_string(first.line) +
        (count > 2 ? " (" + std::to_string(count) + " in all)" : "") +
        "; write a table for each (or take the column out where all are one series)");
}

} // namespace ryn
