#include "CellFiles.h"

#include "Gzip.h"
#include "Import.h"
#include "cells/CellDeclaration.h"

#include "Port/File.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <system_error>
#include <utility>

namespace Tool {

namespace {} // namespace

Status ReadWholeFile(const std::string& name, std::string& text) {
    if (IsGzip(name)) {
        ReadGzip(name, text);
        return Status::Success;
    }
    Port::File file;
    if (!file.open(SystemFileName(name.c_str()), Port::File::Read, true)) {
        return ComplainUnreadable(name, file.GetError());
    }
    constexpr std::size_t Piece = std::size_t(1) << 20;
    std::error_code unknown;
    const std::uintmax_t expected = std::filesystem::file_size(name, unknown);
    text.reserve((unknown ? 0 : expected) + Piece);
    std::size_t size = 0;
    std::size_t count = 0;
    do {
        text.resize(size + Piece);
        count = file.read(text.data() + size, Piece);
        size += count;
    } while (count > 0);
    text.resize(size);
    return file.GetError() == 0 ? Status::Success : ComplainUnreadable(name, file.GetError());
}

Place MakeJsonPlace(const std::string& file, const Import::TextPlace& place) {
    return Place{file, place.line, place.source, Columns{place.column, 1}};
}

Status ReadCellFiles(const std::vector<std::string>& files, Import::CellLibrary& library,
                     Reporter& reporter) {
    for (const std::string& file : files) {
        std::string text;
        const Status read = ReadWholeFile(file, text);
        if (read != Status::Success) {
            return read;
        }
        try {
            library.Add(std::string(WithoutGzip(file)), text);
        } catch (const Cells::Error& error) {
            Diagnostic diagnostic = MakeFileDiagnostic(file, Severity::Error, error.what());
            diagnostic.place.line = error.GetLine();
            reporter.Report(std::move(diagnostic));
            return Status::Failed;
        } catch (const Import::Error& error) {
            Diagnostic diagnostic = MakeFileDiagnostic(file, Severity::Error, error.what());
            diagnostic.place = MakeJsonPlace(file, error.GetPlace());
            reporter.Report(std::move(diagnostic));
            return Status::Failed;
        }
    }
    return Status::Success;
}

} // namespace Tool
