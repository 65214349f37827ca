// Files that cannot be written.
#include "explain/Failure.h"

#include <filesystem>
#include <system_error>

namespace Tool::Explain {

void ExplainFile(const Failure& failure, Explanation& explanation) {
    if (failure.phrase->FindArgument("<file>") < 0) {
        return;
    }
    // The file is the last word if there are options, as the command reads them.
    const int count = failure.words.GetSize();
    const int place = count == 4 || count == 5 ? count - 1 : failure.phrase->CountWords();
    explanation.mark = Mark::Word(place);
    const std::filesystem::path folder =
        std::filesystem::path(failure.GetWord(place)).parent_path();
    std::error_code error;
    if (!folder.empty() && !std::filesystem::exists(folder, error)) {
        explanation.Say("there is no folder " + Show(folder.string()));
    }
}

} // namespace Tool::Explain
