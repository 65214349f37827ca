#include "diff/NetlistTokens.h"

#include "Port/Ascii.h"

namespace Tool::Diff {

namespace {

constexpr int EndOfFile = -1;

bool IsNamePart(int c) {
    const char character = static_cast<char>(c);
    return c != EndOfFile && (Port::IsLetter(character) || Port::IsDigit(character) || c == '_' ||
                              c == '$' || c >= 0x80);
}

bool IsBlank(int c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\f' || c == '\v';
}

} // namespace

NetlistTokens::NetlistTokens(const char* systemName, Language language)
    : language_(language), isOpen_(file_.open(systemName, Port::File::Read, true)) {}

bool NetlistTokens::Fill() {
    constexpr std::size_t Piece = std::size_t(1) << 18;
    if (!isOpen_) {
        return false;
    }
    piece_.resize(Piece);
    piece_.resize(file_.read(piece_.data(), Piece));
    at_ = 0;
    return !piece_.empty();
}

int NetlistTokens::Peek() {
    if (at_ == piece_.size() && !Fill()) {
        return EndOfFile;
    }
    return static_cast<unsigned char>(piece_[at_]);
}

int NetlistTokens::Get() {
    const int c = Peek();
    if (c != EndOfFile) {
        ++at_;
        line_ += c == '\n' ? 1 : 0;
    }
    return c;
}

void NetlistTokens::SkipLine() {
    for (int c = Peek(); c != EndOfFile && c != '\n'; c = Peek()) {
        Get();
    }
}

void NetlistTokens::SkipBlock() {
    int before = 0;
    for (int c = Get(); c != EndOfFile && !(before == '*' && c == '/'); c = Get()) {
        before = c;
    }
}

/// \param c the character that was read last. \return whether it began a comment.
bool NetlistTokens::SkipComment(int c) {
    if (language_ == Language::Json) {
        return false;
    }
    if (c == '/' && Peek() == '*') {
        Get();
        SkipBlock();
        return true;
    }
    const bool isLine =
        language_ == Language::Vhdl ? c == '-' && Peek() == '-' : c == '/' && Peek() == '/';
    // What follows a "`" is a directive.
    if (isLine || (language_ == Language::Verilog && c == '`')) {
        SkipLine();
        return true;
    }
    return false;
}

void NetlistTokens::ReadString(NetlistToken& token) {
    token.kind = NetlistToken::Kind::String;
    for (int c = Get(); c != EndOfFile && c != '"'; c = Get()) {
        if (c == '\\' && language_ != Language::Vhdl) {
            c = Get();
        }
        token.text += static_cast<char>(c);
    }
}

void NetlistTokens::ReadEscaped(NetlistToken& token) {
    token.kind = NetlistToken::Kind::Name;
    token.isEscaped = true;
    const bool isVhdl = language_ == Language::Vhdl;
    for (int c = Get(); c != EndOfFile && (isVhdl ? c != '\\' : !IsBlank(c)); c = Get()) {
        token.text += static_cast<char>(c);
    }
}

bool NetlistTokens::Next(NetlistToken& token) {
    token.text.clear();
    token.isEscaped = false;
    int c = Get();
    while (IsBlank(c) || (c != EndOfFile && SkipComment(c))) {
        c = Get();
    }
    token.line = line_;
    if (c == EndOfFile) {
        token.kind = NetlistToken::Kind::End;
        return false;
    }
    if (c == '"') {
        ReadString(token);
    } else if (c == '\\' && language_ != Language::Json) {
        ReadEscaped(token);
    } else {
        token.kind = IsNamePart(c) ? NetlistToken::Kind::Name : NetlistToken::Kind::Sign;
        token.text += static_cast<char>(c);
        while (token.IsName() && IsNamePart(Peek())) {
            token.text += static_cast<char>(Get());
        }
    }
    return true;
}

} // namespace Tool::Diff
