/// \file
/// Plain text in and out for the benchmark programs: one large buffer each way, nothing else.
#pragma once

#include <array>
#include <charconv>
#include <concepts>
#include <cstddef>
#include <cstdio>
#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>

namespace bench {

struct FileCloser {
    void operator()(std::FILE* file) const noexcept { std::fclose(file); }
};

/// An open C file that closes itself.
using FileHandle = std::unique_ptr<std::FILE, FileCloser>;

inline FileHandle OpenFile(const std::string& path, const char* mode) {
    FileHandle file(std::fopen(path.c_str(), mode));
    if (!file) {
        throw std::runtime_error(path + ": cannot be opened");
    }
    return file;
}

/// Collects text and writes it to a file in large pieces.
class Output {
public:
    explicit Output(const std::string& path) : path_(path), file_(OpenFile(path, "wb")) {
        std::setvbuf(file_.get(), nullptr, _IONBF, 0);
    }

    Output& operator<<(std::string_view text) {
        if (text.size() > buffer_->size() - used_) {
            Flush();
            if (text.size() > buffer_->size()) {
                Write(text.data(), text.size());
                return *this;
            }
        }
        text.copy(buffer_->data() + used_, text.size());
        used_ += text.size();
        return *this;
    }

    Output& operator<<(char character) { return *this << std::string_view(&character, 1); }

    Output& operator<<(std::unsigned_integral auto number) { return WriteNumber(number, 10); }

    Output& WriteHex(std::size_t number) { return WriteNumber(number, 16); }

    /// Must be called at the end: the destructor drops what is still in the buffer.
    void Flush() {
        Write(buffer_->data(), used_);
        used_ = 0;
    }

private:
    Output& WriteNumber(std::unsigned_integral auto number, int base) {
        std::array<char, 24> digits;
        char* const end = digits.data() + digits.size();
        const auto result = std::to_chars(digits.data(), end, number, base);
        return *this << std::string_view(digits.data(), result.ptr);
    }

    void Write(const char* data, std::size_t size) {
        if (std::fwrite(data, 1, size, file_.get()) != size) {
            throw std::runtime_error(path_ + ": cannot be written");
        }
    }

    std::string path_;
    FileHandle file_;
    std::unique_ptr<std::array<char, std::size_t(1) << 18>> buffer_ =
        std::make_unique_for_overwrite<std::array<char, std::size_t(1) << 18>>();
    std::size_t used_ = 0;
};

/// A whole file in memory.
class FileText {
public:
    explicit FileText(const std::string& path) {
        const FileHandle file = OpenFile(path, "rb");
        std::fseek(file.get(), 0, SEEK_END);
        const long size = std::ftell(file.get());
        if (size < 0) {
            throw std::runtime_error(path + ": cannot be read");
        }
        std::rewind(file.get());
        size_ = static_cast<std::size_t>(size);
        text_ = std::make_unique_for_overwrite<char[]>(size_);
        if (std::fread(text_.get(), 1, size_, file.get()) != size_) {
            throw std::runtime_error(path + ": cannot be read");
        }
    }

    const char* begin() const noexcept { return text_.get(); }
    const char* end() const noexcept { return text_.get() + size_; }

private:
    std::unique_ptr<char[]> text_;
    std::size_t size_ = 0;
};

/// The words of one command line, as views into the file. Quotes are not looked at, and words
/// beyond the capacity are dropped: no line of the benchmark design has either.
class Words {
public:
    /// Takes the line that starts at `at`. \return where the next one starts.
    const char* Split(const char* at, const char* end) {
        size_ = 0;
        while (at != end && *at != '\n') {
            const char* wordEnd = at;
            while (wordEnd != end && *wordEnd != ' ' && *wordEnd != '\n') {
                ++wordEnd;
            }
            if (wordEnd != at && size_ < words_.size()) {
                words_[size_++] = std::string_view(at, wordEnd);
            }
            at = wordEnd != end && *wordEnd == ' ' ? wordEnd + 1 : wordEnd;
        }
        return at == end ? end : at + 1;
    }

    std::size_t size() const noexcept { return size_; }
    std::string_view operator[](std::size_t index) const noexcept { return words_[index]; }

private:
    std::array<std::string_view, 8> words_;
    std::size_t size_ = 0;
};

} // namespace bench
