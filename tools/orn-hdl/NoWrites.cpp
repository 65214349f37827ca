#include "NoWrites.h"

#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Language.h"

#include <string>

namespace Tool {

namespace {

class NoWriteCommand final : public Orn_Hdl::Command {
public:
    using Command::Command;
    bool Parse(const Orn_Hdl::StringArray&) override { return true; }
    void Execute() override {}
    const char* GetName() const override { return "WRITE"; }

    static Command* Create(Orn_Hdl::Model* model, const Orn_Hdl::StringArray&) {
        return new NoWriteCommand(model);
    }
};

} // namespace

void DropWrites(Orn_Hdl::CommandFactory& factory) {
    for (const Orn_Hdl::Language language : Orn_Hdl::Languages) {
        const std::string phrase = std::string("WRITE ") + Orn_Hdl::GetLanguageName(language);
        factory.AddCommandCreator(phrase.c_str(), &NoWriteCommand::Create);
    }
}

} // namespace Tool
