#include "Gzip.h"

#include "NetlistText.h"
#include "Port/Ascii.h"
#include "Port/File.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstddef>
#include <cstdio>
#include <map>

#include <zlib.h>

namespace Tool {

namespace {

constexpr std::string_view Suffix = ".gz";
constexpr std::size_t PieceSize = 65536;

[[noreturn]] void Fail(const std::string& file, const std::string& reason) {
    throw GzipError("cannot read " + file + ": " + reason);
}

/// Hands the contents of a compressed file over, piece by piece.
template <class Take> void Read(const std::string& file, const Take& take) {
    GzipReader reader(file);
    std::array<char, PieceSize> piece;
    while (const std::size_t count = reader.Read(piece.data(), piece.size())) {
        take(std::string_view(piece.data(), count));
    }
}

/// Compresses into a file.
class Deflater {
public:
    explicit Deflater(Port::File& file) : file_(file) {
        constexpr int GzipWindow = 15 + 16;
        constexpr int MemoryLevel = 8;
        isReady_ = deflateInit2(&stream_, Z_DEFAULT_COMPRESSION, Z_DEFLATED, GzipWindow,
                                MemoryLevel, Z_DEFAULT_STRATEGY) == Z_OK;
    }
    Deflater(const Deflater&) = delete;
    Deflater& operator=(const Deflater&) = delete;
    ~Deflater() { deflateEnd(&stream_); }

    /// Adds a piece; the last one ends the file. \return whether all went well.
    bool Add(std::string_view piece, bool isLast) {
        stream_.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(piece.data()));
        stream_.avail_in = static_cast<uInt>(piece.size());
        do {
            stream_.next_out = reinterpret_cast<Bytef*>(buffer_.data());
            stream_.avail_out = static_cast<uInt>(buffer_.size());
            if (!isReady_ || deflate(&stream_, isLast ? Z_FINISH : Z_NO_FLUSH) == Z_STREAM_ERROR ||
                !file_.write(buffer_.data(), buffer_.size() - stream_.avail_out)) {
                return false;
            }
        } while (stream_.avail_out == 0);
        return true;
    }

private:
    Port::File& file_;
    z_stream stream_ = {};
    bool isReady_ = false;
    std::array<char, PieceSize> buffer_;
};

} // namespace

GzipReader::GzipReader(const std::string& file) : file_(file) {
    errno = 0;
    input_ = gzopen(file.c_str(), "rb");
    if (input_ == nullptr) {
        Fail(file_, std::string(Port::ErrorText(errno).GetView()));
    }
}

GzipReader::~GzipReader() {
    gzclose(input_);
}

std::size_t GzipReader::Read(char* to, std::size_t count) {
    constexpr std::size_t Most = std::size_t(1) << 30;
    errno = 0;
    const int read = gzread(input_, to, static_cast<unsigned>(std::min(count, Most)));
    if (read > 0) {
        return static_cast<std::size_t>(read);
    }
    int error = Z_OK;
    gzerror(input_, &error);
    if (error == Z_ERRNO) {
        Fail(file_, std::string(Port::ErrorText(errno).GetView()));
    }
    if (read < 0 || error != Z_OK) {
        Fail(file_, error == Z_BUF_ERROR ? "the compressed file ends too early"
                                         : "the compressed file is damaged");
    }
    return 0;
}

bool IsGzip(std::string_view file) noexcept {
    return file.size() > Suffix.size() &&
           Port::EqualIgnoringCase(file.substr(file.size() - Suffix.size()), Suffix);
}

std::string_view WithoutGzip(std::string_view file) noexcept {
    return IsGzip(file) ? file.substr(0, file.size() - Suffix.size()) : file;
}

void ReadGzip(const std::string& file, std::string& text) {
    Read(file, [&text](std::string_view piece) { text += piece; });
}

const char* UnpackGzip(const std::string& file) {
    static std::map<std::string, TemporaryFile> unpacked;
    const auto [place, isNew] = unpacked.try_emplace(file);
    const TemporaryFile& contents = place->second;
    if (isNew && contents.IsOpen()) {
        bool isWritten = true;
        Read(file, [&](std::string_view piece) {
            isWritten &= std::fwrite(piece.data(), 1, piece.size(), contents.Get()) == piece.size();
        });
        if (!isWritten || std::fflush(contents.Get()) != 0) {
            throw GzipError("cannot write a temporary file for " + file);
        }
    }
    if (!contents.IsOpen()) {
        throw GzipError("there is no temporary file for " + file);
    }
    return contents.GetName().c_str();
}

Status WriteGzip(const TemporaryFile& contents, const std::string& file) {
    Port::File output;
    if (!output.open(file.c_str(), Port::File::Replace, true)) {
        return ComplainUnwritable(file, output.GetError());
    }
    Deflater deflater(output);
    std::rewind(contents.Get());
    std::array<char, PieceSize> piece;
    std::size_t count = 0;
    bool isGood = true;
    do {
        count = std::fread(piece.data(), 1, piece.size(), contents.Get());
        isGood = deflater.Add(std::string_view(piece.data(), count), count < piece.size());
    } while (isGood && count == piece.size());
    if (std::ferror(contents.Get()) != 0) {
        return ComplainUnreadable("a temporary file", errno);
    }
    return isGood && output.close() ? Status::Success : ComplainUnwritable(file, output.GetError());
}

} // namespace Tool
