#include "import/TokenBatches.h"

#include <cstring>

namespace Tool::Import {

namespace {

/// Stands for the size of characters that does not fit into a byte, and follows.
constexpr std::uint8_t LongSize = 0xFF;

template <class Value> void AddBytes(std::string& tokens, Value value) {
    char bytes[sizeof value];
    std::memcpy(bytes, &value, sizeof value);
    tokens.append(bytes, sizeof value);
}

template <class Value> Value TakeBytes(const char*& at) {
    Value value;
    std::memcpy(&value, at, sizeof value);
    at += sizeof value;
    return value;
}

void AddCharacters(std::string& tokens, std::uint8_t token, std::string_view text) {
    tokens += static_cast<char>(token);
    if (text.size() < LongSize) {
        tokens += static_cast<char>(text.size());
    } else {
        tokens += static_cast<char>(LongSize);
        AddBytes(tokens, text.size());
    }
    tokens += text;
}

} // namespace

TokenBatches::TokenBatches(JsonScanner& scanner, const Settings& settings)
    : settings_(settings), scanner_(scanner), batches_(settings.batches),
      work_({settings.workers, batches_.size(), true},
            [this](std::size_t number) { return Fill(batches_[number % batches_.size()]); }) {}

/// Scans a batch. \return false if nothing is left.
bool TokenBatches::Fill(Batch& batch) noexcept {
    try {
        Scan(batch);
    } catch (...) {
        state_ = State::Done;
        batch.thrown = std::current_exception();
    }
    return !batch.tokens.empty() || batch.thrown != nullptr;
}

void TokenBatches::Scan(Batch& batch) {
    // Memory for as many bytes is kept for the next batch.
    constexpr std::size_t LongBatch = std::size_t(1) << 20;
    if (batch.tokens.capacity() > LongBatch) {
        batch.tokens = std::string();
    }
    batch.tokens.clear();
    while (state_ != State::Done && batch.tokens.size() < settings_.bytes) {
        const std::size_t complete = batch.tokens.size();
        try {
            ScanNext(batch.tokens);
        } catch (const JsonSyntaxError& error) {
            AddFailure(batch, error);
        } catch (...) {
            batch.tokens.resize(complete);
            AddLastMark(batch.tokens);
            throw;
        }
    }
    batch.bytesRead = scanner_.GetBytesRead();
}

void TokenBatches::ScanNext(std::string& tokens) {
    switch (state_) {
    case State::Beginning:
        scanner_.CheckBeginning();
        state_ = State::Value;
        break;
    case State::Value:
        ScanValue(tokens);
        break;
    case State::Key:
        ScanKey(tokens);
        break;
    case State::Separator:
        ScanSeparator(tokens);
        break;
    case State::Done:
        break;
    }
}

void TokenBatches::ScanValue(std::string& tokens) {
    const Kind kind = scanner_.GetKind();
    kind_ = static_cast<std::uint8_t>(kind);
    state_ = State::Separator;
    switch (kind) {
    case Kind::Object:
        ScanOpening(tokens, OpenObject, '}');
        break;
    case Kind::Array:
        ScanOpening(tokens, OpenArray, ']');
        break;
    case Kind::Text:
        AddCharacters(tokens, Text, scanner_.TakeText());
        break;
    case Kind::Number:
        ScanNumber(tokens);
        break;
    case Kind::Word:
        scanner_.TakeWord();
        tokens += static_cast<char>(Word);
        break;
    }
    kind_ = NoKind;
    before_ = End;
}

void TokenBatches::ScanOpening(std::string& tokens, Token token, char close) {
    tokens += static_cast<char>(token);
    if (!scanner_.TakeOpening(close)) {
        tokens += static_cast<char>(Close);
        return;
    }
    closings_ += close;
    state_ = token == OpenObject ? State::Key : State::Value;
}

void TokenBatches::ScanNumber(std::string& tokens) {
    const Number number = scanner_.TakeNumber();
    tokens += static_cast<char>(number.isInteger ? Integer : OtherNumber);
    if (number.isInteger) {
        AddBytes(tokens, number.value);
    }
}

void TokenBatches::ScanKey(std::string& tokens) {
    AddCharacters(tokens, Key, scanner_.TakeKey());
    before_ = End;
    scanner_.TakeColon();
    before_ = Colon;
    state_ = State::Value;
}

/// Scans what follows a value.
void TokenBatches::ScanSeparator(std::string& tokens) {
    if (closings_.empty()) {
        if (!scanner_.IsAtEnd()) {
            tokens += static_cast<char>(Rest);
        }
        state_ = State::Done;
    } else if (scanner_.TakeSeparator(closings_.back())) {
        before_ = Comma;
        state_ = closings_.back() == '}' ? State::Key : State::Value;
    } else {
        tokens += static_cast<char>(Close);
        closings_.pop_back();
    }
}

/// Adds the comma or colon in front of what cannot be scanned.
void TokenBatches::AddLastMark(std::string& tokens) const {
    if (before_ != End) {
        tokens += static_cast<char>(before_);
    }
}

void TokenBatches::AddFailure(Batch& batch, const JsonSyntaxError& error) {
    batch.error = error;
    if (error.hasPlace) {
        batch.place = scanner_.FindPlace();
    }
    AddLastMark(batch.tokens);
    batch.tokens += static_cast<char>(Failure);
    batch.tokens += static_cast<char>(kind_);
    state_ = State::Done;
}

void TokenBatches::NextBatch() {
    static constexpr char NoMore = End;
    if (batch_ != nullptr && batch_->thrown != nullptr) {
        std::rethrow_exception(batch_->thrown);
    }
    if (!work_.Next()) {
        at_ = &NoMore;
        end_ = at_ + 1;
        return;
    }
    batch_ = &batches_[work_.GetPlace()];
    at_ = batch_->tokens.data();
    end_ = at_ + batch_->tokens.size();
}

TokenBatches::Token TokenBatches::Take() {
    const Token token = Peek();
    if (token == Failure) {
        throw JsonSyntaxError(batch_->error);
    }
    ++at_;
    return token;
}

TokenBatches::Kind TokenBatches::GetKind() {
    const Token token = Peek();
    if (token == OtherNumber) {
        return Kind::Number;
    }
    if (token != Failure) {
        return static_cast<Kind>(token);
    }
    const auto kind = static_cast<std::uint8_t>(at_[1]);
    if (kind == NoKind) {
        throw JsonSyntaxError(batch_->error);
    }
    return static_cast<Kind>(kind);
}

bool TokenBatches::TakeSeparator() {
    const Token token = Peek();
    if (token == Failure || token == Close || token == Comma) {
        Take();
    }
    return token != Close;
}

/// Takes the size and the characters of a text or key.
std::string_view TokenBatches::TakeCharacters() {
    std::size_t size = TakeBytes<std::uint8_t>(at_);
    if (size == LongSize) {
        size = TakeBytes<std::size_t>(at_);
    }
    const std::string_view text(at_, size);
    at_ += size;
    return text;
}

TokenBatches::Number TokenBatches::TakeNumber() {
    Number number;
    number.isInteger = Take() == Integer;
    if (number.isInteger) {
        number.value = TakeBytes<std::int64_t>(at_);
    }
    return number;
}

} // namespace Tool::Import
