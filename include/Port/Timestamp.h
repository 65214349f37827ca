/// \file
/// `UT_TIMESTAMP`, an instant split into the texts of its fields.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <ctime>

/// An instant: year in four digits, every other field in two.
class ORN_HDL_API UT_TIMESTAMP {
public:
    /// The present instant in local time. When the environment variable SOURCE_DATE_EPOCH holds a
    /// number of seconds since 1970, that instant in UTC, so that builds can be repeated.
    UT_TIMESTAMP();
    /// An instant in UTC.
    static UT_TIMESTAMP FromUtc(std::time_t instant);

    /// The year in four digits.
    Port::String getTimeStampYear() const;
    /// The month in two digits, "01" for January.
    Port::String getTimeStampMonthNumber() const;
    /// The day of the month in two digits, from "01".
    Port::String getTimeStampMonthDay() const;
    /// The hour of the day in two digits, from "00" to "23".
    Port::String getTimeStampHour() const;
    /// The minute in two digits, from "00".
    Port::String getTimeStampMinute() const;
    /// The second in two digits, from "00".
    Port::String getTimeStampSecond() const;

private:
    explicit UT_TIMESTAMP(const std::tm& fields) : fields_(fields) {}

    std::tm fields_;
};
