#include "Orn_Hdl/Language.h"

#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Streams.h"
#include "Support/Names.h"

#include <gtest/gtest.h>

#include <iterator>
#include <string>

namespace {

using namespace Orn_Hdl;

TEST(Languages, HaveTheirNames) {
    ASSERT_EQ(std::size(Languages), 2U);
    EXPECT_STREQ(GetLanguageName(Languages[0]), "Verilog");
    EXPECT_STREQ(GetLanguageName(Languages[1]), "VHDL");
}

TEST(Languages, AValueThatIsNoneIsTheFirst) {
    EXPECT_STREQ(GetLanguageName(static_cast<Language>(7)), "Verilog");
    EXPECT_STREQ(GetLanguageName(static_cast<Language>(-1)), "Verilog");
}

TEST(Languages, HaveTheirCommentsInTheHeader) {
    const char* const starts[] = {"////", "----"};
    for (const Language language : Languages) {
        TextMemOutStream out;
        HdlUtilities::WriteHeader("top", language, HdlOptions(), out);
        const std::string text = Support::Text(out.GetValue());
        EXPECT_EQ(text.substr(0, 4), starts[static_cast<int>(language)]) << text;
    }
}

} // namespace
