// Netlists that are proven before they replace a file.

#include "Exception/Failure.h"
#include "Orn_Hdl/Proof.h"
#include "Orn_Hdl/Streams.h"
#include "Port/File.h"

#include <cerrno>
#include <cstdio>
#include <memory>
#include <string>

namespace Orn_Hdl {

namespace {

[[noreturn]] void FailTemporarily(int error) {
    Fail(ProofUnit, __LINE__, "A temporary file for the proof cannot be used: %s.\n",
         {Port::ErrorText(error).GetView()});
}

void RequireNoError(int error) {
    if (error != 0) {
        FailTemporarily(error);
    }
}

} // namespace

void Proof::Write(TextFileOutStream& out, const Port::TextArgument& shownName, Language language,
                  const std::function<void(OutStream&)>& write,
                  const std::function<Written()>& getWritten) {
    const auto prove = [&](const char* fileName) {
        const Written written = getWritten();
        Require(fileName, shownName, language, written.netlist, written.options);
    };
    const Port::String replacement = out.FlushToRead();
    if (!replacement.IsEmpty() || out.GetError() != 0) {
        write(out);
        out.FlushToRead();
        if (out.GetError() == 0) {
            prove(replacement.CStr());
        }
        return;
    }
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(std::tmpfile(), &std::fclose);
    if (file == nullptr) {
        FailTemporarily(errno);
    }
    const std::string name = "/dev/fd/" + std::to_string(fileno(file.get()));
    TextFileOutStream text(name.c_str(), TextFileOutStream::Overwrite);
    write(text);
    text.Close();
    RequireNoError(text.GetError());
    prove(name.c_str());
    RequireNoError(out.WriteFile(name.c_str()));
}

} // namespace Orn_Hdl
