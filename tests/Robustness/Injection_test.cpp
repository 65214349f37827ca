// Texts with line ends that try to break out of their comment or literal. Whatever lines they
// contain, a netlist without its comments and the contents of its literals must stay the same.
#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/ShortTexts.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace {

using namespace Orn_Hdl;

enum class Language { Verilog, Vhdl };

/// Reads a netlist as a tool does that takes every format effector but the tab for a line end.
/// What remains are the words and signs outside comments, with one sign for each literal.
class Skeleton {
public:
    Skeleton(std::string_view text, Language language) : rest_(text), language_(language) {
        while (!rest_.empty()) {
            Next();
        }
    }

    const std::string& GetText() const noexcept { return skeleton_; }

private:
    static bool EndsLine(char c) noexcept { return c >= '\n' && c <= '\r'; }
    static bool IsOfWord(char c) noexcept {
        return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '_' || c == '\'' ||
               c == '?' || c == '.' || c == '$' || static_cast<unsigned char>(c) >= 0x80;
    }

    bool Begins(std::string_view what) const noexcept {
        return rest_.substr(0, what.size()) == what;
    }

    void Next() {
        const bool isVerilog = language_ == Language::Verilog;
        if (Begins(isVerilog ? "//" : "--")) {
            while (!rest_.empty() && !EndsLine(rest_[0])) {
                rest_.remove_prefix(1);
            }
        } else if (isVerilog && Begins("/*")) {
            const std::size_t end = rest_.find("*/", 2);
            Take(end == std::string_view::npos ? "<open comment>" : "", end, 2);
        } else if (rest_[0] == '"') {
            ReadString();
        } else if (std::isdigit(static_cast<unsigned char>(rest_[0])) != 0) {
            ReadNumber();
        } else if (IsOfWord(rest_[0])) {
            ReadWord();
        } else {
            Take(rest_[0] == ' ' || EndsLine(rest_[0]) ? "" : rest_.substr(0, 1), 0, 1);
        }
    }

    /// Adds a piece to the skeleton and leaves so much of the text behind.
    void Take(std::string_view piece, std::size_t end, std::size_t more) {
        if (!piece.empty()) {
            skeleton_.append(piece).append(" ");
        }
        rest_.remove_prefix(end == std::string_view::npos ? rest_.size() : end + more);
    }

    void ReadString() {
        std::size_t i = 1;
        for (; i < rest_.size() && rest_[i] != '"' && !EndsLine(rest_[i]); ++i) {
            i += language_ == Language::Verilog && rest_[i] == '\\' ? 1 : 0;
        }
        const bool isClosed = i < rest_.size() && rest_[i] == '"';
        const bool goesOn =
            isClosed && language_ == Language::Vhdl && rest_.substr(i + 1, 1) == "\"";
        Take(!isClosed ? "<open string>"
             : goesOn  ? ""
                       : "<string>",
             std::min(i, rest_.size() - 1), 1);
    }

    /// A whole range counts as one number.
    void ReadNumber() {
        constexpr std::string_view Signs = "+-:";
        std::size_t i = 0;
        while (i < rest_.size() &&
               (IsOfWord(rest_[i]) || Signs.find(rest_[i]) != std::string_view::npos)) {
            ++i;
        }
        Take("<number>", i, 0);
    }

    void ReadWord() {
        std::size_t i = 0;
        while (i < rest_.size() && IsOfWord(rest_[i])) {
            ++i;
        }
        const bool isBit = i == 3 && rest_[0] == '\'' && rest_[2] == '\'';
        Take(isBit ? "<number>" : rest_.substr(0, i), i, 0);
    }

    std::string_view rest_;
    Language language_;
    std::string skeleton_;
};

/// What a text holds of digits, letters and line ends: numbers are written as they are.
std::string Digits(const char* text) {
    std::string digits(text);
    const auto isOther = [](char c) {
        return std::isalnum(static_cast<unsigned char>(c)) == 0 && !(c >= '\n' && c <= '\r');
    };
    digits.erase(std::remove_if(digits.begin(), digits.end(), isOther), digits.end());
    return digits;
}

/// A design with one text wherever a text is taken.
class Design {
public:
    explicit Design(const std::string& text) : text_(text.c_str()), model_(&factory_) {
        auto* const cell = new Component("CELL");
        model_.GetNetlist()->SetName("top");
        model_.GetNetlist()->Add(cell);
        cell->AddPin("I", Polarity("in"), text_);
        cell->AddPin("D(3:0)", Polarity("out"), text_);
        auto* const instance = new Instance("U1", cell);
        model_.GetNetlist()->Add(instance);
        auto* const port = new ScalarSignal("P");
        port->SetPortPolarity(Polarity("in"));
        auto* const bus = new Bus("B(3:0)");
        model_.GetNetlist()->Add(port);
        model_.GetNetlist()->Add(bus);
        Decorate(*model_.GetNetlist());
        Decorate(*cell);
        Decorate(*instance);
        Decorate(*port);
        Decorate(*bus);
        Decorate(*cell->GetPin("I"));
        Decorate(*instance->GetPin("I"));
        port->Connect(instance->GetPin("I"));
        bus->AssignConstantValue(("4:B:1" + Digits(text_)).c_str());
        SetOptions();
    }

    void Write(Language language, OutStream& out) {
        if (language == Language::Verilog) {
            VerilogNetlister(out).WriteNetlist(model_.GetNetlist(), *model_.GetOptions());
        } else {
            VhdlNetlister(out).WriteNetlist(model_.GetNetlist(), model_.GetOptions());
        }
    }

    HdlOptions& GetOptions() { return *model_.GetOptions(); }

private:
    template <class T> void Decorate(T& object) {
        object.AddComment(text_);
        AddAttr(object, "Text", "String", text_);
        AddAttr(object, "Own", "User", text_);
        AddAttr(object, "Whole", "Integer", text_);
        AddAttr(object, "Real", "Float", text_);
        AddAttr(object, "Truth", "Boolean", text_);
        AddAttr(object, "One", "Bit", text_);
        AddAttr(object, "Bits", "BitVector", ("8:H:0" + Digits(text_)).c_str());
        AddAttr(object, "Bare", "BitVector", ("0" + Digits(text_)).c_str());
    }

    void AddAttr(AttributeHolder& holder, const char* name, const char* type, const char* value) {
        // The value of a user's type is a VHDL expression: it stands in no literal there.
        const bool isUser = std::string_view(type) == "User";
        for (const char* generic : {"NONE", "SYN", "NOSYN"}) {
            if (isUser && std::string_view(generic) != "NONE") {
                continue;
            }
            std::unique_ptr<Attribute> attribute(AttributeFactory::GetCreators().Get(type)(
                (std::string(name) + generic).c_str(), value));
            attribute->SetGeneric(generic);
            attribute->SetSynAttr("ASSIGN");
            if (isUser) {
                static_cast<AttributeUser&>(*attribute).SetUserType("own_type");
            }
            holder.AddAttr(attribute.release());
        }
    }

    void SetOptions() {
        HdlOptions& options = *model_.GetOptions();
        options.application = options.command = options.device = text_;
        options.purpose = options.reference = text_;
        options.verilog.includePaths.Add(text_);
    }

    const char* text_;
    CommandFactory factory_;
    Model model_;
};

/// All forms that a design can be written in, as skeletons.
std::vector<std::string> SkeletonsOf(const std::string& text, const std::string& file) {
    std::vector<std::string> skeletons;
    Design design(text);
    const auto write = [&](Language language) {
        TextMemOutStream memory;
        design.Write(language, memory);
        skeletons.push_back(Skeleton(memory.GetValue().GetView(), language).GetText());
        TextFileOutStream stream(file.c_str(), false);
        design.Write(language, stream);
        stream.Close();
        skeletons.push_back(Skeleton(Support::ReadWholeFile(file), language).GetText());
    };
    for (int tool = HdlOptions::VerilogOption::QSN; tool <= HdlOptions::VerilogOption::PRECISION;
         ++tool) {
        design.GetOptions().verilog.synthesisType = tool;
        write(Language::Verilog);
    }
    write(Language::Vhdl);
    return skeletons;
}

class Injection : public testing::Test {
protected:
    void Check(const std::string& text) {
        const std::vector<std::string> skeletons = SkeletonsOf(text, file_);
        for (std::size_t i = 0; i < skeletons.size(); ++i) {
            ASSERT_EQ(skeletons[i], expected_[i]) << i << ": " << testing::PrintToString(text);
        }
    }

    Support::TemporaryFolder folder_;
    const std::string file_ = folder_ / "written";
    const std::vector<std::string> expected_ = SkeletonsOf("plain", file_);
};

TEST_F(Injection, TheSkeletonIsWhatToolsSee) {
    EXPECT_EQ(Skeleton("a<=\"x\"\"y\";--z\rb", Language::Vhdl).GetText(), "a < = <string> ; b ");
    EXPECT_EQ(Skeleton("a = \"x\\\"y\"; /* z */ 8'hFF // b", Language::Verilog).GetText(),
              "a = <string> ; <number> ");
    EXPECT_EQ(Skeleton("\"x\ny\"", Language::Vhdl).GetText(), "<open string> y <open string> ");
    EXPECT_EQ(Skeleton("/* x", Language::Verilog).GetText(), "<open comment> ");
    ASSERT_EQ(expected_.size(), 14u);
    EXPECT_NE(expected_[0].find("endmodule"), std::string::npos);
    EXPECT_NE(expected_[0].find("<string>"), std::string::npos);
    EXPECT_NE(expected_[12].find("end BEHAVIORAL"), std::string::npos);
    EXPECT_EQ(expected_[0].find("plain"), std::string::npos) << expected_[0];
    EXPECT_EQ(expected_[12].find("plain"), std::string::npos) << expected_[12];
}

TEST_F(Injection, AnyShortTextStaysInItsPlace) {
    Support::ForEachText("a-\n\r\v ", 4, [this](const std::string& text) { Check(text); });
}

TEST_F(Injection, StatementsStayInTheirPlace) {
    for (const char* text : {"\nendmodule\n", "\rend BEHAVIORAL;\r", "a\v end; \f end;", "--\n--",
                             "//\nendmodule", "\n`define y", "\r\nend;\r\n", "a\n", "\n",
                             "\xe2\x80\xa8 end;\n", "(* keep *)\n;", "'; end; '\n"}) {
        Check(text);
    }
}

TEST_F(Injection, LongTextsAreNotBrokenOutOfTheirPlace) {
    std::string text;
    for (int i = 0; i < 12; ++i) {
        text += " word, word -- // \n word";
        Check(text);
        Check("x" + text + "\n");
    }
}

TEST_F(Injection, OfTheHeaderAlone) {
    const Port::StringBase<char> hostile("a\nb\r\vc\fd \n \re");
    for (const bool vhdl : {false, true}) {
        TextMemOutStream out;
        NetlistHeader(hostile, hostile, hostile, hostile, hostile, hostile, hostile, vhdl, out)
            .Write();
        const std::string text(out.GetValue().GetView());
        EXPECT_EQ(Skeleton(text, vhdl ? Language::Vhdl : Language::Verilog).GetText(), "");
        EXPECT_EQ(text.find_first_of("\r\v\f"), std::string::npos);
    }
}

} // namespace
