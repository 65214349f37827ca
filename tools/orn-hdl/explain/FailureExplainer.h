// Says of a line that failed what is wrong with it.
#pragma once

#include "diagnostics/CommandLines.h"
#include "diagnostics/Diagnostic.h"

#include "Orn_Hdl/Containers/StringArray.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace Orn_Hdl {
class Model;
}

namespace Tool {

/// Makes the diagnostics of lines that failed: the text of the failure, the word concerned, and
/// notes on what the user may have meant. Everything is found out after the failure, from the words
/// of the line, the model as it is then, and the command file, which is read again. For the first
/// failures all names of the design and all lines of the file are searched; later ones get the
/// notes that take no search, so that many failures in a large file take no long time.
class FailureExplainer {
public:
    /// \param lines must outlive this object, as must the model.
    FailureExplainer(Orn_Hdl::Model& model, CommandLines& lines);

    /// \param message the text of the failure, with or without a line end.
    Diagnostic Explain(std::uint64_t line, const Orn_Hdl::StringArray& words,
                       std::string_view message);

private:
    Orn_Hdl::Model& model_;
    CommandLines& lines_;
    /// The same file, read from its start for each search.
    SourceLines searched_;
    /// Places of other lines.
    CommandLines others_;
    int searches_ = 0;
};

} // namespace Tool
