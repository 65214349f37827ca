// The words and marks of a JSON text, scanned one by one or ahead on another processor.
#pragma once

#include "import/JsonScanner.h"
#include "import/TextSource.h"
#include "import/TokenBatches.h"

#include <cstddef>
#include <memory>
#include <string_view>

namespace Tool::Import {

/// Has the functions of a `JsonScanner`. What is given and thrown is the same with and without
/// batches.
class JsonTokens {
public:
    using Kind = JsonScanner::Kind;
    using Number = JsonScanner::Number;

    /// \param source not owned. Nobody else may use it as long as this object exists.
    explicit JsonTokens(TextSource& source) : scanner_(source) {}
    /// Scans ahead.
    JsonTokens(TextSource& source, const TokenBatches::Settings& settings)
        : scanner_(source), batches_(std::make_unique<TokenBatches>(scanner_, settings)) {}

    void CheckBeginning() { batches_ ? batches_->CheckBeginning() : scanner_.CheckBeginning(); }
    bool IsAtEnd() { return batches_ ? batches_->IsAtEnd() : scanner_.IsAtEnd(); }
    std::size_t GetBytesRead() const noexcept {
        return batches_ ? batches_->GetBytesRead() : scanner_.GetBytesRead();
    }
    /// The place of the `JsonSyntaxError` that was thrown. Nothing can be taken afterwards.
    TextPlace FindPlace() { return batches_ ? batches_->GetPlace() : scanner_.FindPlace(); }

    Kind GetKind() { return batches_ ? batches_->GetKind() : scanner_.GetKind(); }
    bool TakeOpening(char close) {
        return batches_ ? batches_->TakeOpening() : scanner_.TakeOpening(close);
    }
    bool TakeSeparator(char close) {
        return batches_ ? batches_->TakeSeparator() : scanner_.TakeSeparator(close);
    }
    std::string_view TakeKey() { return batches_ ? batches_->TakeKey() : scanner_.TakeKey(); }
    void TakeColon() { batches_ ? batches_->TakeColon() : scanner_.TakeColon(); }
    std::string_view TakeText() { return batches_ ? batches_->TakeText() : scanner_.TakeText(); }
    Number TakeNumber() { return batches_ ? batches_->TakeNumber() : scanner_.TakeNumber(); }
    void TakeWord() { batches_ ? batches_->TakeWord() : scanner_.TakeWord(); }

private:
    alignas(TokenBatches::CacheLine) JsonScanner scanner_;
    /// Null if nothing is scanned ahead.
    alignas(TokenBatches::CacheLine) std::unique_ptr<TokenBatches> batches_;
};

} // namespace Tool::Import
