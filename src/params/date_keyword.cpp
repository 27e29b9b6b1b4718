#include "params/date_keyword.h"

namespace ryn {

void PutDate(KvfTree* file, std::string_view keyword, const COleDateTime& date) {
    const COleDateTime::Fields fields = date.GetFields();
    kvfPutListParam(file, keyword, "iiiii",
                    {fields.year, fields.month, fields.day, fields.hour, fields.minute});
}

bool GetDate(const KvfSection* section, std::string_view keyword, COleDateTime* date) {
    int year = 0;
    int month = 0;
    int day = 0;
    int hour = 0;
    int minute = 0;
    if (kvfGetListParam(section, keyword, 1, "iiiii", {&year, &month, &day, &hour, &minute}) == 0)
        return false;
    *date = COleDateTime(year, month, day, hour, minute, 0);
    return true;
}

} // namespace ryn
