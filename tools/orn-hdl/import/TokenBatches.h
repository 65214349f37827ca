// The words and marks of a JSON text, scanned on another processor.
#pragma once

#include "import/JsonScanner.h"

#include "Port/OrderedWork.h"

#include <cstddef>
#include <cstdint>
#include <exception>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Import {

/// Scans a text in a thread of its own, some batches ahead, and gives what a scanner gives. The
/// functions throw `JsonSyntaxError` where the scanner does, and what the source of the text throws
/// when all that was scanned before has been taken.
class TokenBatches {
public:
    using Kind = JsonScanner::Kind;
    using Number = JsonScanner::Number;

    /// What the scanning writes and what the taking uses stand in different lines of this many
    /// bytes: a line that two processors shared would cost more than the scanning.
    static constexpr std::size_t CacheLine = 64;

    struct Settings {
        /// How many threads there are besides the owner's; they take turns.
        unsigned workers = 1;
        /// How many batches there are.
        std::size_t batches = 8;
        /// A batch ends with the word or mark that reaches this many bytes.
        std::size_t bytes = std::size_t(1) << 16;
    };

    /// Begins to scan.
    /// \param scanner not owned. As long as there are batches of it, nobody else may use it or its
    ///        source.
    TokenBatches(JsonScanner& scanner, const Settings& settings);

    /// Fails unless the text begins with an object or an array.
    void CheckBeginning() { GetKind(); }
    /// Whether nothing but blanks is left.
    bool IsAtEnd() { return Peek() == End; }
    /// How many bytes had been read when the present batch was scanned.
    std::size_t GetBytesRead() const noexcept { return batch_ == nullptr ? 0 : batch_->bytesRead; }
    /// The place of the `JsonSyntaxError` that was thrown.
    const TextPlace& GetPlace() const noexcept { return batch_->place; }

    /// What kind of value comes next.
    Kind GetKind();
    /// Takes the mark that opens an object or an array.
    /// \return false if the mark that closes it follows, which is taken, too.
    bool TakeOpening() {
        Take();
        return !TakeIf(Close);
    }
    /// Takes what follows a member: a comma, or the mark that closes the object or array.
    /// \return whether it is a comma.
    bool TakeSeparator();
    /// Takes the name of a field. It is valid until the next call.
    std::string_view TakeKey() { return TakeText(); }
    /// Takes the colon behind the name of a field.
    void TakeColon() {
        if (!TakeIf(Colon) && Peek() == Failure) {
            Take();
        }
    }
    /// Takes a text, which comes next. It is valid until the next call.
    std::string_view TakeText() {
        Take();
        return TakeCharacters();
    }
    /// Takes a number, which comes next.
    Number TakeNumber();
    /// Takes true, false or null, if one of these comes next.
    void TakeWord() { Take(); }

private:
    /// What a batch consists of, a byte each. Commas and colons only precede a failure, so that it
    /// is known where it belongs.
    enum Token : std::uint8_t {
        /// The first ones are those of `Kind`.
        OpenObject,
        OpenArray,
        /// Its size and its characters follow.
        Text,
        /// Its value follows.
        Integer,
        Word,
        /// A number that is not an integer, or does not fit.
        OtherNumber,
        /// Of an object or array.
        Close,
        /// The name of a field. Its size and its characters follow.
        Key,
        Comma,
        Colon,
        /// The text is no JSON. The kind of the value follows that is wrong, if it has one.
        Failure,
        /// Something follows the value that the text is.
        Rest,
        End
    };
    /// Stands for the kind where there is no value, or where it has none.
    static constexpr std::uint8_t NoKind = 0xFF;

    struct alignas(CacheLine) Batch {
        std::string tokens;
        /// How many bytes of the text were read when it was scanned.
        std::size_t bytesRead = 0;
        /// What its last token is about, if that is a failure.
        JsonSyntaxError error;
        TextPlace place;
        /// What the source has thrown behind the last token.
        std::exception_ptr thrown;
    };
    /// What is scanned next.
    enum class State : std::uint8_t { Beginning, Value, Key, Separator, Done };

    // The scanning, by whichever thread carries out a job.
    bool Fill(Batch& batch) noexcept;
    void Scan(Batch& batch);
    void ScanNext(std::string& tokens);
    void ScanValue(std::string& tokens);
    void ScanOpening(std::string& tokens, Token token, char close);
    void ScanNumber(std::string& tokens);
    void ScanKey(std::string& tokens);
    void ScanSeparator(std::string& tokens);
    void AddLastMark(std::string& tokens) const;
    void AddFailure(Batch& batch, const JsonSyntaxError& error);

    // The taking.
    void NextBatch();
    Token Peek() {
        while (at_ == end_) {
            NextBatch();
        }
        return static_cast<Token>(*at_);
    }
    bool TakeIf(Token token) {
        const bool isThere = Peek() == token;
        at_ += isThere ? 1 : 0;
        return isThere;
    }
    /// Takes the next token, unless scanning has failed there.
    Token Take();
    std::string_view TakeCharacters();

    const Settings settings_;

    // What the scanning uses.
    alignas(CacheLine) JsonScanner& scanner_;
    State state_ = State::Beginning;
    /// The marks that will close the objects and arrays around what is scanned.
    std::string closings_;
    /// The comma or colon that was scanned last, if nothing followed it yet; otherwise `End`.
    Token before_ = End;
    /// The kind of the value that is being scanned.
    std::uint8_t kind_ = NoKind;

    // What the taking uses.
    alignas(CacheLine) std::vector<Batch> batches_;
    /// The batch whose tokens are being taken; null before the first.
    const Batch* batch_ = nullptr;
    const char* at_ = nullptr;
    const char* end_ = nullptr;
    /// Last, since its threads use the others.
    Port::OrderedWork work_;
};

} // namespace Tool::Import
