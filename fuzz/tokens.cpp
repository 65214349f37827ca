// The input is a command line: it is split in all ways, and looked up among the phrases.

#include "Bytes.h"
#include "Check.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Exception.h"
#include "Port/Ascii.h"

#include <memory>

namespace {

using Fuzz::Check;
using namespace Orn_Hdl;

/// The longest phrase of the catalogue that the words begin with; null when there is none.
const CommandInfo* FindSlowly(const StringArray& words) {
    const CommandInfo* found = nullptr;
    std::string beginning;
    for (int i = 0; i < words.GetSize(); ++i) {
        beginning.append(i == 0 ? "" : " ").append(words.GetView(i));
        for (const CommandInfo& command : CommandFactory::GetCatalogue()) {
            if (Port::EqualIgnoringCase(beginning, command.phrase)) {
                found = &command;
            }
        }
    }
    return found;
}

void CheckLookUp(const StringArray& words) {
    static const CommandFactory factory;
    const CommandInfo* const expected = FindSlowly(words);
    const std::unique_ptr<Command> command(factory.CreateCommand(nullptr, words));
    Check((command == nullptr) == (expected == nullptr), "a phrase is found when it is there");
    if (command == nullptr) {
        return;
    }
    Check(std::string(command->GetName()) == expected->phrase, "the longest phrase is found");
    command->Parse(words);
    try {
        command->Execute();
        Check(false, "a command without a model fails");
    } catch (const Exception& exception) {
        Check(exception.getLocalized() == "Missing Model.\n", "it fails for want of the model");
    }
}

/// Splitting only leaves characters out.
void CheckWords(std::string_view line, const StringArray& words) {
    std::size_t at = 0;
    for (int i = 0; i < words.GetSize(); ++i) {
        for (const char c : words.GetView(i)) {
            at = line.find(c, at);
            Check(at != std::string_view::npos, "words come from the line, in order");
            ++at;
        }
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Fuzz::Bytes bytes(data, size);
    const std::string line(bytes.Rest());
    StringArray words;
    Check(words.ParseCommandLine(line) == words.GetSize(), "the number of words is told");
    CheckWords(line, words);
    CheckLookUp(words);

    const std::string separators = bytes.Text(4);
    const std::string quotes = bytes.Text(5);
    const std::string text(bytes.Rest());
    for (const bool skipEmpty : {false, true}) {
        StringArray pieces;
        Check(pieces.Parse(text, separators, skipEmpty, quotes) == pieces.GetSize(),
              "the number of pieces is told");
        CheckWords(text, pieces);
    }
    return 0;
}
