// The input is a command line: it is split in all ways, and looked up among the phrases.

#include "Bytes.h"
#include "Check.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Exception.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Fuzz::Check;
using namespace Orn_Hdl;

struct Phrases {
    Phrases() {
        for (const CommandInfo& command : CommandFactory::GetCatalogue()) {
            all.emplace_back(command.phrase);
            longest = std::max(longest, all.back().size());
        }
    }

    std::vector<std::string_view> all;
    std::size_t longest = 0;
};

/// The longest phrase of the catalogue that the words begin with; empty if there is none.
std::string_view FindSlowly(const StringArray& words) {
    static const Phrases phrases;
    std::string_view found;
    std::string beginning;
    // No phrase equals a text that is longer than the longest phrase.
    for (int i = 0; i < words.GetSize() && beginning.size() <= phrases.longest; ++i) {
        beginning.append(i == 0 ? "" : " ").append(words.GetView(i));
        for (const std::string_view phrase : phrases.all) {
            if (Port::EqualIgnoringCase(beginning, phrase)) {
                found = phrase;
            }
        }
    }
    return found;
}

void CheckLookUp(const StringArray& words) {
    static const CommandFactory factory;
    const std::string_view expected = FindSlowly(words);
    const std::unique_ptr<Command> command(factory.CreateCommand(nullptr, words));
    Check((command == nullptr) == expected.empty(), "a phrase is found if the line begins with it");
    if (command == nullptr) {
        return;
    }
    Check(command->GetName() == expected, "the longest phrase is found");
    command->Parse(words);
    try {
        command->Execute();
        Check(false, "a command without a model fails");
    } catch (const Exception& exception) {
        Check(exception.getLocalized() == "Missing Model.\n",
              "the message names the missing model");
    }
}

/// Checks that splitting only leaves characters out.
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
