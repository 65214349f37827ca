#include "Tool.h"

#include "Gzip.h"
#include "Port/File.h"

#include <cerrno>
#include <cstdio>
#include <string>

namespace Tool {

namespace {

Status ComplainAbout(std::string_view what, std::string_view file, int error) {
    std::string text("cannot ");
    text.append(what).append(" ").append(file).append(": ");
    text.append(Port::ErrorText(error).GetView());
    Complain(text);
    return Status::File;
}

} // namespace

void PrintError(std::string_view line) {
    std::string text(line);
    text += '\n';
    // In one call, so that the lines of programs that share a terminal are not mixed.
    std::fwrite(text.data(), 1, text.size(), stderr);
}

void Complain(std::string_view text) {
    PrintError(std::string("orn-hdl: ").append(text));
}

Status ComplainUnreadable(std::string_view file, int error) {
    return ComplainAbout("read", file, error);
}

Status ComplainUnwritable(std::string_view file, int error) {
    return ComplainAbout("write", file, error);
}

Status Print(std::string_view text) {
    const bool written = std::fwrite(text.data(), 1, text.size(), stdout) == text.size();
    if (written && std::fflush(stdout) == 0) {
        return Status::Success;
    }
    return ComplainUnwritable("standard output", errno);
}

const char* SystemFileName(const char* file) {
    if (IsGzip(file)) {
        return UnpackGzip(file);
    }
    return std::string_view(file) == "-" ? "/dev/stdin" : file;
}

} // namespace Tool
