#include "Port/Timestamp.h"

#include "Port/Text.h"

#include <cstdlib>

namespace {

Port::String TwoDigits(int value) {
    return Port::String::Format("%02d", value);
}

} // namespace

UT_TIMESTAMP::UT_TIMESTAMP() : fields_() {
    long seconds = 0;
    if (Port::strtol(std::getenv("SOURCE_DATE_EPOCH"), seconds)) {
        *this = FromUtc(seconds);
        return;
    }
    const std::time_t now = std::time(nullptr);
    localtime_r(&now, &fields_);
}

UT_TIMESTAMP UT_TIMESTAMP::FromUtc(std::time_t instant) {
    std::tm fields{};
    gmtime_r(&instant, &fields);
    return UT_TIMESTAMP(fields);
}

Port::String UT_TIMESTAMP::getTimeStampYear() const {
    return Port::String::Format("%04lld", fields_.tm_year + 1900LL);
}

Port::String UT_TIMESTAMP::getTimeStampMonthNumber() const {
    return TwoDigits(fields_.tm_mon + 1);
}

Port::String UT_TIMESTAMP::getTimeStampMonthDay() const {
    return TwoDigits(fields_.tm_mday);
}

Port::String UT_TIMESTAMP::getTimeStampHour() const {
    return TwoDigits(fields_.tm_hour);
}

Port::String UT_TIMESTAMP::getTimeStampMinute() const {
    return TwoDigits(fields_.tm_min);
}

Port::String UT_TIMESTAMP::getTimeStampSecond() const {
    return TwoDigits(fields_.tm_sec);
}
