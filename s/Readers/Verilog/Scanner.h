// The words and signs of Verilog source text, as IEEE 1364-2005 clauses 3 and 19 define them.
#pragma once

#include "Readers/Comments.h"
#include "Readers/InputText.h"
#include "Readers/Place.h"
#include "Readers/Verilog/Setup.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers {

enum class TokenKind : std::uint8_t {
    End,
    /// A name or a keyword.
    Name,
    /// An escaped name; the text is without the backslash.
    EscapedName,
    /// A name that begins with "$", which the text includes.
    SystemName,
    /// A number as it stands in the file, with blanks inside when it has any.
    Number,
    /// A string; the text is what stands between the quotes.
    String,
    /// "(*" and "*)".
    AttributesBegin,
    AttributesEnd,
    /// Any other character.
    Sign
};

/// The signs "+:" and "-:".
constexpr char PlusColon = 'p';
constexpr char MinusColon = 'm';

struct Token {
    TokenKind kind = TokenKind::End;
    /// The character of a sign.
    char sign = '\0';
    /// Valid until the next token is read.
    std::string_view text;
    Place place;
};

/// Reads the tokens of a file. Compiler directives are carried out on the way.
class Scanner {
public:
    /// Which comments are kept, by their texts; null for none.
    using CommentFilter = bool (*)(std::string_view text);

    /// \param files, setup must outlive the scanner.
    Scanner(Files& files, const VerilogSetup& setup);
    Scanner(const Scanner&) = delete;
    Scanner& operator=(const Scanner&) = delete;
    ~Scanner();

    /// Starts reading a file; the first token is read by `Next`.
    void Open(const std::string& fileName);
    /// Reads the next token.
    void Next();
    /// Reads on to the next semicolon, which is the token then, without looking at the tokens
    /// before it. Nothing happens when the token is one.
    void SkipToSemicolon();
    /// The token that was read last.
    const Token& Get() const noexcept { return token_; }

    void SetCommentFilter(CommentFilter filter) noexcept { filter_ = filter; }
    /// The comments that were kept since the list was emptied.
    std::vector<Comment>& GetComments() noexcept { return comments_; }

    /// The files named by include directives that are kept, in order.
    const std::vector<std::string>& GetKeptIncludes() const noexcept { return keptIncludes_; }
    /// Tells the scanner whether it is inside of a module, where no include directive can be kept.
    void SetInModule(bool inModule) noexcept { isInModule_ = inModule; }
    /// Whether an undeclared name is a net ("`default_nettype").
    bool HasImplicitNets() const noexcept { return hasImplicitNets_; }

    /// Throws for an error at the token that was read last.
    [[noreturn]] void Fail(std::string_view text) const { FailAt(files_, token_.place, text); }
    [[noreturn]] void Fail(const Place& place, std::string_view text) const {
        FailAt(files_, place, text);
    }
    const Files& GetFiles() const noexcept { return files_; }

private:
    struct Source;
    struct Macro {
        std::string text;
        bool hasArguments = false;
    };
    /// One `ifdef that is open.
    struct Condition {
        Place place;
        bool wasTrue = false;
        bool hasElse = false;
    };

    void PushFile(const std::string& fileName, const Place& place);
    void PushMacro(const Macro& macro, const Place& place);
    bool Pop();
    Place GetPlace() const noexcept;
    char PeekSecond();
    bool IsAtEnd();
    void EndLine() noexcept;

    bool SkipBlanks();
    void SkipLineComment();
    void SkipBlockComment();
    void KeepComment(std::string_view text, bool isBlock, const Place& place);
    template <class IsPart> std::string_view TakeWhile(IsPart isPart);
    void SkipRestOfLine();

    void ScanEscapedName();
    void ScanNumber();
    void ScanBasedDigits();
    void ScanString();
    void ScanSign(char sign);
    void SkipInLine();

    void ReadDirective();
    bool CarryOut(std::string_view directive, const Place& place);
    std::string ReadDirectiveWord();
    std::string ReadIncludeName(const Place& place);
    void ReadDefine(const Place& place);
    std::string ReadMacroText();
    void ReadInclude(const Place& place);
    std::string FindIncluded(const std::string& name) const;
    void ReadNetType(const Place& place);
    void UseMacro(const std::string& name, const Place& place);
    void BeginCondition(bool isTrue, const Place& place);
    void ReadElse(bool hasName, const Place& place);
    void EndCondition(const Place& place);
    void SkipInactive();
    bool SkipToDirective();
    void SkipEscapedOrString();

    Files& files_;
    const VerilogSetup& setup_;
    std::vector<std::unique_ptr<Source>> sources_;
    /// The text of the innermost source.
    InputText* input_ = nullptr;
    Source* source_ = nullptr;
    Token token_;
    CommentFilter filter_ = nullptr;
    std::vector<Comment> comments_;
    std::map<std::string, Macro, std::less<>> macros_;
    std::vector<Condition> conditions_;
    std::vector<std::string> keptIncludes_;
    std::size_t openedFiles_ = 0;
    /// How many characters macros have been replaced by, and how many they may be.
    std::uint64_t expanded_ = 0;
    std::uint64_t granted_ = 0;
    bool isInModule_ = false;
    bool hasImplicitNets_ = true;
};

} // namespace Orn_Hdl::Readers
