#include "Orn_Hdl/Writers/NetlistHeader.h"

#include "Orn_Hdl/Options.h"
#include "Support/Environment.h"
#include "Support/Names.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <sstream>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Orn_Hdl::NetlistHeader;
using Orn_Hdl::TextFileOutStream;
using Orn_Hdl::TextMemOutStream;

struct Texts {
    std::string application = "app";
    std::string fileName = "top.v";
    std::string command = "orn-hdl run top.cmd";
    std::string designName = "top";
    std::string device = "hx1";
    std::string purpose = "structure";
    std::string reference = "none";
};

void Write(const Texts& texts, bool vhdl, Orn_Hdl::OutStream& out) {
    NetlistHeader(texts.application.c_str(), texts.fileName.c_str(), texts.command.c_str(),
                  texts.designName.c_str(), texts.device.c_str(), texts.purpose.c_str(),
                  texts.reference.c_str(), vhdl, out)
        .Write();
}

std::string BannerOf(const Texts& texts, bool vhdl) {
    TextMemOutStream out;
    Write(texts, vhdl, out);
    return Support::Text(out.GetValue());
}

std::vector<std::string> LinesOf(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) {
        lines.push_back(line);
    }
    return lines;
}

/// The lines from "Purpose:" to the end.
std::vector<std::string> SentencesOf(const Texts& texts, bool vhdl) {
    const std::vector<std::string> lines = LinesOf(BannerOf(texts, vhdl));
    return std::vector<std::string>(lines.begin() + 15, lines.end());
}

TEST(NetlistHeader, ADividerIsEightyCharactersLong) {
    EXPECT_EQ(LinesOf(BannerOf({}, true)).at(0), std::string(80, '-'));
    EXPECT_EQ(LinesOf(BannerOf({}, false)).at(0), std::string(80, '/'));
}

TEST(NetlistHeader, HasItsLinesInOrder) {
    for (const bool vhdl : {true, false}) {
        const std::string prefix = vhdl ? "--" : "//";
        const std::string text = BannerOf({}, vhdl);
        const std::vector<std::string> lines = LinesOf(text);
        ASSERT_EQ(lines.size(), 19u) << text;
        EXPECT_EQ(text.back(), '\n');
        EXPECT_EQ(lines[1].rfind(prefix + " ", 0), 0u) << lines[1];
        EXPECT_GT(lines[1].size(), 3u) << "a copyright notice";
        EXPECT_EQ(lines[2], lines[0]);
        EXPECT_EQ(lines[12], prefix + "Command: orn-hdl run top.cmd");
        EXPECT_EQ(lines[13], prefix + "Design Name: top");
        EXPECT_EQ(lines[14], prefix + "Device: hx1");
        EXPECT_EQ(lines[15], prefix + "Purpose:");
        EXPECT_EQ(lines[16], prefix + "    structure ");
        EXPECT_EQ(lines[17], prefix + "Reference");
        EXPECT_EQ(lines[18], prefix + "    none ");
    }
}

TEST(NetlistHeader, EveryLineIsAComment) {
    Texts texts;
    texts.purpose = "a\nb\n\nc \n d";
    texts.reference = "\n";
    for (const bool vhdl : {true, false}) {
        for (const std::string& line : LinesOf(BannerOf(texts, vhdl))) {
            EXPECT_EQ(line.rfind(vhdl ? "--" : "//", 0), 0u) << line;
        }
    }
}

TEST(NetlistHeader, TheEmblemHasItsLabelsInAColumn) {
    const Support::EnvironmentVariable epoch("SOURCE_DATE_EPOCH", "0");
    const std::vector<std::string> lines = LinesOf(BannerOf({}, false));
    const std::vector<std::string> labels{
        "Vendor: Halvex",
        "Version : " + Support::Text(Orn_Hdl::HdlUtilities::GetVersion()),
        "Application : app",
        "Filename : top.v",
        "Timestamp : 01/01/1970 00:00:00",
    };
    // The emblem's nine lines are 3 to 11; its third to seventh carry the labels.
    const std::size_t column = lines.at(5).find("Vendor: ");
    ASSERT_NE(column, std::string::npos) << lines.at(5);
    for (std::size_t i = 0; i < labels.size(); ++i) {
        EXPECT_EQ(lines.at(5 + i).substr(column), labels[i]);
    }
    for (const std::size_t i : {3u, 4u, 10u, 11u}) {
        EXPECT_EQ(lines.at(i).rfind("//", 0), 0u);
        EXPECT_EQ(lines.at(i).find(" : "), std::string::npos) << lines.at(i);
    }
}

TEST(NetlistHeader, TextsOfOneLineKeepToTheirLine) {
    Texts texts;
    texts.application = "a\nb";
    texts.fileName = "c\nd";
    texts.command = "e\n\nf";
    texts.designName = "\ng";
    texts.device = "h\n";
    const std::vector<std::string> lines = LinesOf(BannerOf(texts, true));
    ASSERT_EQ(lines.size(), 19u);
    EXPECT_TRUE(lines[7].ends_with("Application : a b")) << lines[7];
    EXPECT_TRUE(lines[8].ends_with("Filename : c d")) << lines[8];
    EXPECT_EQ(lines[12], "--Command: e  f");
    EXPECT_EQ(lines[13], "--Design Name:  g");
    EXPECT_EQ(lines[14], "--Device: h ");
}

TEST(NetlistHeader, EmptyTextsLeaveTheirLabels) {
    const std::vector<std::string> lines = LinesOf(BannerOf({"", "", "", "", "", "", ""}, true));
    ASSERT_EQ(lines.size(), 19u);
    EXPECT_EQ(lines[12], "--Command: ");
    EXPECT_EQ(lines[13], "--Design Name: ");
    EXPECT_EQ(lines[14], "--Device: ");
    EXPECT_EQ(lines[16], "--    ");
    EXPECT_EQ(lines[18], "--    ");
}

TEST(NetlistHeader, AnEndlessWordStandsOnALineOfItsOwn) {
    const std::string word(200, 'w');
    Texts texts;
    texts.purpose = "a " + word + " b";
    EXPECT_EQ(SentencesOf(texts, true),
              (std::vector<std::string>{"--Purpose:", "--    a ", "--    " + word + " ", "--    b ",
                                        "--Reference", "--    none "}));
}

TEST(NetlistHeader, AWordEndsBeforeColumnEighty) {
    // A word of 72 characters behind the prefix and four blanks: 6 + 72 + 1 = 79.
    Texts texts;
    texts.purpose = std::string(72, 'x');
    texts.reference = std::string(73, 'x');
    EXPECT_EQ(
        SentencesOf(texts, false),
        (std::vector<std::string>{"//Purpose:", "//    " + std::string(72, 'x') + " ",
                                  "//Reference", "//    ", "//    " + std::string(73, 'x') + " "}));
}

TEST(NetlistHeader, ALineFeedContinuesOnANewLineAtTheSameIndent) {
    Texts texts;
    texts.purpose = "one two\nthree four\nfive\nsix seven";
    texts.reference = "a\nb";
    EXPECT_EQ(
        SentencesOf(texts, true),
        (std::vector<std::string>{"--Purpose:", "--    one two", "--    three four", "--    five ",
                                  "--    six seven ", "--Reference", "--    a", "--    b "}));
}

/// The layout of sentences again.
std::vector<std::string> LayOutSlowly(const std::string& prefix, const std::string& text) {
    std::vector<std::string> lines{prefix + "    "};
    std::size_t column = 6;
    const auto beginLine = [&] {
        lines.push_back(prefix + "    ");
        column = 6;
    };
    for (const std::string& word :
         Support::NamesOf(Orn_Hdl::StringArray(text.c_str(), " ", true, nullptr))) {
        if (word.size() + column + 1 > 79) {
            beginLine();
        }
        if (word.find('\n') == std::string::npos) {
            lines.back() += word + " ";
            column += word.size() + 1;
            continue;
        }
        const Support::Names pieces =
            Support::NamesOf(Orn_Hdl::StringArray(word.c_str(), "\n", true, nullptr));
        for (std::size_t i = 0; i < pieces.size(); ++i) {
            if (i == 0) {
                lines.back() += pieces[0];
                beginLine();
                continue;
            }
            lines.back() += pieces[i] + " ";
            column += pieces[i].size() + 1;
            if (i + 1 < pieces.size()) {
                beginLine();
            }
        }
    }
    return lines;
}

/// Words of which some hold line feeds, but none holds nothing else.
std::string AnyText() {
    std::string text;
    const auto words =
        *rc::gen::scale(3.0, rc::gen::container<std::vector<std::string>>(rc::gen::scale(
                                 0.2, rc::gen::nonEmpty(rc::gen::container<std::string>(
                                          rc::gen::elementOf(std::string("abcdefgh\n")))))));
    for (const std::string& word : words) {
        if (word.find_first_not_of('\n') != std::string::npos) {
            text += word + " ";
        }
    }
    return text;
}

RC_GTEST_PROP(NetlistHeader, LaysSentencesOutAsTheRuleSays, (bool vhdl)) {
    Texts texts;
    texts.purpose = AnyText();
    texts.reference = AnyText();
    const std::string prefix = vhdl ? "--" : "//";
    std::vector<std::string> expected{prefix + "Purpose:"};
    for (const std::string& line : LayOutSlowly(prefix, texts.purpose)) {
        expected.push_back(line);
    }
    expected.push_back(prefix + "Reference");
    for (const std::string& line : LayOutSlowly(prefix, texts.reference)) {
        expected.push_back(line);
    }
    RC_ASSERT(SentencesOf(texts, vhdl) == expected);
}

TEST(NetlistHeader, AFileHoldsTheSameBanner) {
    const Support::EnvironmentVariable epoch("SOURCE_DATE_EPOCH", "0");
    const Support::TemporaryFolder folder;
    Texts texts;
    texts.application = std::string(60, 'a') + " " + std::string(60, 'b');
    texts.command = "one two, three " + std::string(100, 'c') + " four";
    texts.purpose = "x\ny " + std::string(90, 'd') + " z";
    for (const bool vhdl : {true, false}) {
        {
            TextFileOutStream out((folder / "banner").c_str(), false);
            Write(texts, vhdl, out);
        }
        EXPECT_EQ(Support::ReadWholeFile(folder / "banner"), BannerOf(texts, vhdl))
            << "comment lines are never broken";
    }
}

TEST(NetlistHeader, CanBeCopiedAndWrittenTwice) {
    const Support::EnvironmentVariable epoch("SOURCE_DATE_EPOCH", "0");
    TextMemOutStream out;
    const NetlistHeader header("a", "b", "c", "d", "e", "f", "g", true, out);
    NetlistHeader copy(header);
    copy.Write();
    const std::string once = Support::Text(out.GetValue());
    copy.Write();
    EXPECT_EQ(Support::Text(out.GetValue()), once + once);
}

TEST(NetlistHeader, UserTextIsNoFormat) {
    Texts texts;
    texts.command = texts.purpose = "%s%n%d";
    const std::string text = BannerOf(texts, true);
    EXPECT_NE(text.find("--Command: %s%n%d\n"), std::string::npos);
    EXPECT_NE(text.find("--    %s%n%d \n"), std::string::npos);
}

} // namespace
