#include "Port/Timestamp.h"

#include "Port/Version.h"
#include "Support/Environment.h"
#include "Support/Names.h"

#include <gtest/gtest.h>

#include <ctime>
#include <regex>
#include <string>

namespace {

std::string Show(const UT_TIMESTAMP& stamp) {
    using Support::Text;
    return Text(stamp.getTimeStampYear()) + "-" + Text(stamp.getTimeStampMonthNumber()) + "-" +
           Text(stamp.getTimeStampMonthDay()) + " " + Text(stamp.getTimeStampHour()) + ":" +
           Text(stamp.getTimeStampMinute()) + ":" + Text(stamp.getTimeStampSecond());
}

std::string ShowLocal(std::time_t instant) {
    std::tm fields{};
    localtime_r(&instant, &fields);
    char text[64];
    std::strftime(text, sizeof text, "%Y-%m-%d %H:%M:%S", &fields);
    return text;
}

/// Whether the stamp shows a moment of now, in local time.
void ExpectLocalNow() {
    const std::time_t before = std::time(nullptr);
    const std::string shown = Show(UT_TIMESTAMP());
    const std::time_t after = std::time(nullptr);
    bool found = false;
    for (std::time_t instant = before; instant <= after; ++instant) {
        found = found || shown == ShowLocal(instant);
    }
    EXPECT_TRUE(found) << shown << ", but it is " << ShowLocal(after);
}

TEST(Timestamp, FillsFieldsWithZeros) {
    EXPECT_EQ(Show(UT_TIMESTAMP::FromUtc(0)), "1970-01-01 00:00:00");
    EXPECT_EQ(Show(UT_TIMESTAMP::FromUtc(951782400 + 3661)), "2000-02-29 01:01:01");
    EXPECT_EQ(Show(UT_TIMESTAMP::FromUtc(4102444799)), "2099-12-31 23:59:59");
}

TEST(Timestamp, ShowsTheLocalTime) {
    const Support::EnvironmentVariable noEpoch("SOURCE_DATE_EPOCH", nullptr);
    for (const char* zone : {"UTC0", "AAA+7:30", "BBB-11"}) {
        const Support::EnvironmentVariable timeZone("TZ", zone);
        ExpectLocalNow();
    }
}

TEST(Timestamp, ShowsTheInstantOfSourceDateEpochInUtc) {
    const Support::EnvironmentVariable timeZone("TZ", "AAA+7:30");
    const Support::EnvironmentVariable epoch("SOURCE_DATE_EPOCH", "1700000000");
    EXPECT_EQ(Show(UT_TIMESTAMP()), "2023-11-14 22:13:20");
}

TEST(Timestamp, IgnoresASourceDateEpochThatIsNoNumber) {
    for (const char* text : {"", "yesterday", "12x"}) {
        const Support::EnvironmentVariable epoch("SOURCE_DATE_EPOCH", text);
        ExpectLocalNow();
    }
}

TEST(Timestamp, SurvivesAnyNumber) {
    for (const char* text :
         {"-1", "0", "9223372036854775807", "-9223372036854775808", "99999999999999999999999"}) {
        const Support::EnvironmentVariable epoch("SOURCE_DATE_EPOCH", text);
        EXPECT_FALSE(Show(UT_TIMESTAMP()).empty()) << text;
    }
}

TEST(Version, IsThreeNumbers) {
    const std::string version = Support::Text(Port::Version::getValue("version"));
    EXPECT_TRUE(std::regex_match(version, std::regex("[0-9]+\\.[0-9]+\\.[0-9]+"))) << version;
}

TEST(Version, KnowsNoOtherKey) {
    for (const char* key : {"", "Version", "name", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(Port::Version::getValue(key), "");
    }
}

} // namespace
