#include "Orn_Hdl/Streams.h"

#include "Streams/DirectText.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <array>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Orn_Hdl::DirectText;
using Orn_Hdl::OutStream;
using Orn_Hdl::TextFileOutStream;
using Orn_Hdl::TextMemOutStream;

/// The lines of a file stream again, laid out by the plainest means.
class SlowFileText {
public:
    void Indent() { ++level_; }
    void Unindent() { level_ = std::max(level_ - 1, 0); }

    void Write(std::string text) {
        for (std::size_t end = text.find('\n'); end != std::string::npos; end = text.find('\n')) {
            StartLine();
            file_ += line_ + text.substr(0, end + 1);
            line_.clear();
            text.erase(0, end + 1);
        }
        if (!text.empty()) {
            Append(text);
        }
    }

    void Flush() {
        if (!IsLineEmpty()) {
            Break(line_.size());
            holdsOnlyBlanksOfFlush_ = true;
        }
    }

    bool IsInsideLiteral() const { return IsInsideLiteral(line_.size()); }

    const std::string& GetFile() const { return file_; }

private:
    bool IsLineEmpty() const { return line_.empty() || holdsOnlyBlanksOfFlush_; }

    void StartLine() {
        if (IsLineEmpty()) {
            line_ = GetIndentation();
            holdsOnlyBlanksOfFlush_ = false;
        }
    }

    std::string GetIndentation() const {
        std::string indentation;
        for (int i = 0; i < level_; ++i) {
            indentation += "   ";
        }
        return indentation;
    }

    bool IsComment() const {
        return line_.find("//") != std::string::npos || line_.find("--") != std::string::npos ||
               line_.find("/*") != std::string::npos;
    }

    void Append(const std::string& text) {
        StartLine();
        if (!IsComment() && line_.size() + text.size() > 80) {
            BreakSomewhere();
        }
        line_ += text;
    }

    /// Whether the position is between quotes, either with or without counting quotes behind a
    /// backslash.
    bool IsInsideLiteral(std::size_t place) const {
        int all = 0;
        int plain = 0;
        for (std::size_t i = 0; i < place; ++i) {
            std::size_t backslashes = 0;
            while (backslashes < i && line_[i - backslashes - 1] == '\\') {
                ++backslashes;
            }
            all += line_[i] == '"' ? 1 : 0;
            plain += line_[i] == '"' && backslashes % 2 == 0 ? 1 : 0;
        }
        return all % 2 != 0 || plain % 2 != 0;
    }

    /// The length of the line up to its last such character outside literals, 0 when it has none.
    std::size_t EndOfLast(char wanted) const {
        for (std::size_t i = line_.size(); i > 0; --i) {
            if (line_[i - 1] == wanted && !IsInsideLiteral(i - 1)) {
                return i;
            }
        }
        return 0;
    }

    void BreakSomewhere() {
        if (EndOfLast(' ') != 0) {
            Break(EndOfLast(' '));
        } else if (EndOfLast(',') != 0) {
            Break(EndOfLast(','));
        } else if (!IsInsideLiteral()) {
            Break(line_.size());
        }
    }

    void Break(std::size_t length) {
        file_ += line_.substr(0, length) + "\n";
        line_ = GetIndentation() + "      " + line_.substr(length);
    }

    std::string file_;
    std::string line_;
    bool holdsOnlyBlanksOfFlush_ = false;
    int level_ = 0;
};

/// What a caller does to a stream: write a text, several pieces or a number, indent, unindent,
/// flush. Pieces and line ends can also go straight into its line.
struct Step {
    enum Kind { Write, Pieces, DirectPieces, DirectEnd, Number, In, Out, Flush } kind;
    /// Of pieces, a "|" stands between two of them. Of an end, what stands in front of it.
    std::string text;
};

constexpr std::size_t MostPieces = 5;

/// The pieces of a step; those that it does not have are empty.
std::array<std::string_view, MostPieces> PiecesOf(const Step& step) {
    std::array<std::string_view, MostPieces> pieces;
    std::string_view rest = step.text;
    for (std::string_view& piece : pieces) {
        piece = rest.substr(0, rest.find('|'));
        rest.remove_prefix(std::min(piece.size() + 1, rest.size()));
    }
    return pieces;
}

std::ostream& operator<<(std::ostream& out, const Step& step) {
    return out << step.kind << " <" << step.text << ">";
}

void Apply(const Step& step, OutStream& out) {
    switch (step.kind) {
    case Step::Write:
        out << step.text.c_str();
        break;
    case Step::Pieces: {
        const auto pieces = PiecesOf(step);
        out.WritePieces({pieces[0], pieces[1], pieces[2], pieces[3], pieces[4]});
        break;
    }
    case Step::DirectPieces: {
        const auto pieces = PiecesOf(step);
        DirectText(out).Put(pieces[0], pieces[1], pieces[2], pieces[3], pieces[4]);
        break;
    }
    case Step::DirectEnd:
        if (step.text.empty()) {
            DirectText(out).EndLine();
        } else {
            DirectText(out).EndLine(step.text);
        }
        break;
    case Step::Number:
        out << std::stoi(step.text);
        break;
    case Step::In:
        out.Indent();
        break;
    case Step::Out:
        out.Unindent();
        break;
    case Step::Flush:
        out << OutStream::Flush;
        break;
    }
}

void Apply(const Step& step, SlowFileText& slow) {
    switch (step.kind) {
    case Step::Write:
    case Step::Number:
        slow.Write(step.text);
        break;
    case Step::DirectEnd:
        slow.Write(step.text + "\n");
        break;
    case Step::Pieces:
    case Step::DirectPieces:
        for (const std::string_view piece : PiecesOf(step)) {
            slow.Write(std::string(piece));
        }
        break;
    case Step::In:
        slow.Indent();
        break;
    case Step::Out:
        slow.Unindent();
        break;
    case Step::Flush:
        slow.Flush();
        break;
    }
}

/// Gives a file stream and its slow double the same steps, case after case, and compares the files.
class Comparison {
public:
    Comparison() : out_((folder_ / "text").c_str(), false) {}

    void Run(const std::vector<Step>& steps) {
        starts_.push_back(slow_.GetFile().size());
        cases_.push_back(steps);
        for (const Step& step : steps) {
            if (step.kind == Step::Flush && slow_.IsInsideLiteral()) {
                continue; // it would tear the literal apart
            }
            Apply(step, out_);
            Apply(step, slow_);
        }
    }

    void ExpectSameText() {
        out_.Close();
        slow_.Flush();
        const std::string written = Support::ReadWholeFile(folder_ / "text");
        const std::string& expected = slow_.GetFile();
        if (written == expected) {
            return;
        }
        const auto difference = static_cast<std::size_t>(
            std::mismatch(written.begin(), written.end(), expected.begin(), expected.end()).first -
            written.begin());
        const auto number = static_cast<std::size_t>(
            std::upper_bound(starts_.begin(), starts_.end(), difference) - starts_.begin() - 1);
        std::string steps;
        for (const Step& step : cases_[number]) {
            steps += std::to_string(step.kind) + " <" + step.text + ">\n";
        }
        const std::size_t start = starts_[number];
        ADD_FAILURE() << "after the steps\n"
                      << steps << "expected\n"
                      << expected.substr(start, 300) << "\nbut it is\n"
                      << written.substr(start, 300);
    }

private:
    Support::TemporaryFolder folder_;
    TextFileOutStream out_;
    SlowFileText slow_;
    std::vector<std::size_t> starts_;
    std::vector<std::vector<Step>> cases_;
};

std::string Fill(std::string text, std::size_t length) {
    text.resize(length, 'x');
    return text;
}

/// Runs every sequence of `length` of the steps after each beginning, at three indent levels.
void CompareAllSequences(const std::vector<Step>& alphabet, std::size_t length,
                         const std::vector<std::string>& beginnings) {
    Comparison comparison;
    for (int level = 0; level < 3; ++level) {
        for (const std::string& beginning : beginnings) {
            std::vector<std::size_t> chosen(length, 0);
            for (bool more = true; more;) {
                std::vector<Step> steps{{Step::Write, beginning}};
                for (const std::size_t choice : chosen) {
                    steps.push_back(alphabet[choice]);
                }
                steps.push_back({Step::Write, "\n"});
                comparison.Run(steps);
                more = false;
                for (std::size_t& choice : chosen) {
                    if (++choice < alphabet.size()) {
                        more = true;
                        break;
                    }
                    choice = 0;
                }
            }
        }
        comparison.Run({{Step::In, ""}});
    }
    comparison.ExpectSameText();
}

const std::vector<Step>& NastySteps() {
    static const std::vector<Step> steps{{Step::Write, "a"},
                                         {Step::Write, " "},
                                         {Step::Write, ","},
                                         {Step::Write, "\""},
                                         {Step::Write, "-"},
                                         {Step::Write, "/"},
                                         {Step::Write, "*"},
                                         {Step::Write, "b\nc"},
                                         {Step::Write, "\n"},
                                         {Step::Write, ", d"},
                                         {Step::Number, "-12"},
                                         {Step::Write, "\"e f,g\""},
                                         {Step::Flush, ""},
                                         {Step::Write, std::string(85, 'y')},
                                         {Step::Write, "\\"},
                                         {Step::Pieces, "|a|, |bc\n|"},
                                         {Step::DirectPieces, "|a|, |b\"c|d"},
                                         {Step::DirectEnd, ","}};
    return steps;
}

TEST(Wrapping, AgreesWithASlowLayoutOnAllShortSequencesNearTheEdge) {
    CompareAllSequences(NastySteps(), 3,
                        {"", Fill("", 79), Fill("", 80), Fill("a b,", 78), Fill("a,b", 78),
                         Fill("a \"b c,d\"", 78), Fill("a,\"b ", 78), Fill("\"a ", 79),
                         Fill("a \"b \\c\" d", 78), Fill("a \"b \\\" c", 78),
                         Fill("a \"b \\\\\" c", 78), Fill("a -", 78) + "-", "   " + Fill("", 70)});
}

TEST(Wrapping, AgreesWithASlowLayoutOnAllShortSequencesOfLongPieces) {
    CompareAllSequences({{Step::Write, std::string(40, 'a')},
                         {Step::Write, std::string(39, 'b')},
                         {Step::Write, " "},
                         {Step::Write, ","},
                         {Step::Write, "\""},
                         {Step::Write, "\n"},
                         {Step::Number, "1234567890"},
                         {Step::In, ""},
                         {Step::Out, ""}},
                        4, {"", " ", "x y"});
}

TEST(Wrapping, AgreesWithASlowLayoutOnPiecesOfEveryLengthAtEveryPlace) {
    Comparison comparison;
    for (int level = 0; level < 30; ++level) {
        for (std::size_t length = 0; length <= 82; ++length) {
            for (const char* pieces : {"|", ",|", "x\n|", "\n|y", "|\x1F|\x80", " |0123456"}) {
                for (const Step::Kind kind : {Step::Pieces, Step::DirectPieces}) {
                    comparison.Run({{kind, Fill("a", length) + "|" + pieces},
                                    {kind, "|" + Fill("", length / 2) + "|.|" + pieces},
                                    {Step::DirectEnd, length % 2 == 0 ? "" : ","}});
                }
            }
        }
        comparison.Run({{Step::In, ""}});
    }
    comparison.ExpectSameText();
}

TEST(Wrapping, FindsALineFeedAnywhereInAPiece) {
    Comparison comparison;
    comparison.Run({{Step::In, ""}});
    for (std::size_t length = 1; length <= 40; ++length) {
        for (std::size_t place = 0; place < length; ++place) {
            std::string piece(length, 'a');
            piece[place] = '\n';
            comparison.Run({{Step::Pieces, "b|" + piece + "|c"},
                            {Step::Write, piece},
                            {Step::DirectPieces, piece + "|d"},
                            {Step::DirectPieces, "e|" + piece},
                            {Step::DirectEnd, piece}});
        }
    }
    comparison.ExpectSameText();
}

rc::Gen<std::vector<Step>> AnySteps(bool plain) {
    using namespace rc;
    const auto pieceOf = [](std::string alphabet) {
        return gen::scale(0.4, gen::container<std::string>(gen::elementOf(std::move(alphabet))));
    };
    const auto write =
        gen::map(pieceOf(plain ? "abcdef,; " : "abcd  ,\"\\-/*\n"), [](std::string text) {
            return Step{Step::Write, std::move(text)};
        });
    const auto pieces =
        gen::map(pieceOf(plain ? "abcdef,; |||" : "abcd  ,\"\\-/*\n\t||||"), [](std::string text) {
            return Step{text.size() % 2 == 0 ? Step::Pieces : Step::DirectPieces, std::move(text)};
        });
    const auto number = gen::map(gen::arbitrary<int>(), [](int value) {
        return Step{Step::Number, std::to_string(value)};
    });
    const auto other = gen::map(gen::element(Step::In, Step::Out, Step::Flush, Step::DirectEnd),
                                [](Step::Kind kind) {
                                    return Step{kind, ""};
                                });
    const auto step =
        plain ? gen::weightedOneOf<Step>({{4, write}, {4, pieces}, {1, number}})
              : gen::weightedOneOf<Step>({{8, write}, {8, pieces}, {3, number}, {2, other}});
    return gen::scale(3.0, gen::container<std::vector<Step>>(step));
}

RC_GTEST_PROP(Wrapping, AgreesWithASlowLayoutOnAnySteps, ()) {
    Comparison comparison;
    comparison.Run(*AnySteps(false));
    comparison.ExpectSameText();
    RC_ASSERT(!testing::Test::HasFailure());
}

RC_GTEST_PROP(Wrapping, WithoutItsBreaksAFileHoldsTheTextOfAMemoryStream, ()) {
    const Support::TemporaryFolder folder;
    TextMemOutStream memory;
    {
        TextFileOutStream file((folder / "text").c_str(), false);
        for (const Step& step : *AnySteps(true)) {
            Apply(step, file);
            Apply(step, memory);
        }
    }
    std::string text = Support::ReadWholeFile(folder / "text");
    const std::string lineBreak = "\n      ";
    for (std::size_t at = text.find(lineBreak); at != std::string::npos;
         at = text.find(lineBreak)) {
        text.erase(at, lineBreak.size());
    }
    if (!text.empty()) {
        RC_ASSERT(text.back() == '\n');
        text.pop_back();
    }
    RC_ASSERT(text == std::string(memory.GetValue().GetView()));
}

} // namespace
