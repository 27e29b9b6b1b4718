#include "import/date_order.h"

#include <algorithm>

#include "import/record_reader.h"
#include "import/table_shape.h"
#include "import/time_reader.h"

namespace ryn {

namespace {

/// Drops the forms that cannot read a row which another one reads.
void Narrow(const std::vector<std::string_view>& fields, TimeLayout probe,
            std::vector<DateForm>* forms) {
    std::vector<DateForm> reading;
    for (const DateForm form : *forms) {
        probe.form = form;
        Millis moment = 0;
        if (TimeReader(probe).Read(fields, &moment) == TimeResult::Ok)
            reading.push_back(form);
    }
    // A row that no form reads decides nothing; reading will name it.
    if (!reading.empty())
        *forms = std::move(reading);
}

} // namespace

Status DecideDateOrder(TextSource& source, TableLayout* layout) {
    if (layout->time.rivals.empty())
        return Status::Ok();
    std::vector<DateForm> forms = {layout->time.form};
    forms.insert(forms.end(), layout->time.rivals.begin(), layout->time.rivals.end());
    RecordReader reader(source, layout->encoding, layout->delimiter);
    TableRecord record;
    FieldList fields;
    ReadResult result = reader.SkipLines(layout->dataLine - 1);
    while (forms.size() > 1 && result == ReadResult::Found) {
        result = reader.ReadLine(&record);
        if (result != ReadResult::Found ||
            CommentMarkSize(record.text, layout->commentMarks) > 0) // quotes mean nothing there
            continue;
        result = reader.Split(&record, &fields);
        if (result == ReadResult::Found)
            Narrow(fields.All(), layout->time, &forms);
    }
    if (result == ReadResult::Failed)
        return reader.Error();
    if (forms.size() > 1) {
        std::string names;
        for (const DateForm form : forms)
            names += (names.empty() ? "" : " or ") + DateFormName(form);
        return Status::InputFault(source.Name() + ": the dates may be " + names +
                                  ", and no row decides; tell which with --time-format, such as " +
                                  "%d/%m/%Y or %m/%d/%Y");
    }
    layout->time.form = forms[0];
    layout->time.rivals.clear();
    return source.Rewind();
}

} // namespace ryn
