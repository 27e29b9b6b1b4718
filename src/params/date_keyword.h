#pragma once

#include <string_view>

#include "base/ole_date_time.h"
#include "kvf/kvf.h"

namespace ryn {

/// A date as one keyword of five ints: year, month, day, hour, minute. An invalid date is five
/// times -1. Seconds are not stored and read back as 0.
void PutDate(KvfTree* file, std::string_view keyword, const COleDateTime& date);
/// False, with the date as it was, when the keyword is not there.
bool GetDate(const KvfSection* section, std::string_view keyword, COleDateTime* date);

} // namespace ryn
