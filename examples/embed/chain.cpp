// Adds a phrase to the command language and replays a command file that uses it:
//
//   ADD CHAIN <component> <instance> <count> <from> <to>
//
// places a row of <count> instances of a component with the pins I and O between the signals <from>
// and <to>, each reading the one before it.
//
// chain FILE

#include <Orn_Hdl/Orn_Hdl.h>

#include <iostream>
#include <string>

namespace {

class AddChainCommand : public Orn_Hdl::Command {
public:
    static Orn_Hdl::Command* Create(Orn_Hdl::Model* model, const Orn_Hdl::StringArray& /*tokens*/) {
        return new AddChainCommand(model);
    }

    /// The words of the phrase stand at 0 and 1.
    bool Parse(const Orn_Hdl::StringArray& tokens) override {
        component_ = tokens.GetView(2);
        instance_ = tokens.GetView(3);
        from_ = tokens.GetView(5);
        to_ = tokens.GetView(6);
        return tokens.GetSize() == 7 && tokens.GetIntAt(4, count_, 0) && count_ > 0;
    }

    void Execute() override {
        std::string signal = from_;
        for (int i = 1; i <= count_; ++i) {
            const std::string name = instance_ + std::to_string(i);
            const std::string next = i == count_ ? to_ : name + "_O";
            GetModel()->AddInstance(name, component_);
            GetModel()->ConnectSignalToPin(signal, name, "I");
            GetModel()->ConnectSignalToPin(next, name, "O");
            signal = next;
        }
    }

    const char* GetName() const override { return "ADD CHAIN"; }

private:
    explicit AddChainCommand(Orn_Hdl::Model* model) : Command(model) {}

    std::string component_;
    std::string instance_;
    std::string from_;
    std::string to_;
    int count_ = 0;
};

void PrintVerilog(Orn_Hdl::Model& model) {
    model.GetOptions()->writeHeader = false;
    Orn_Hdl::TextMemOutStream verilog;
    Orn_Hdl::VerilogNetlister(verilog).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    std::cout << verilog.GetValue().GetView();
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        std::cerr << "usage: chain FILE\n";
        return 2;
    }
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel("chain", argv[1]);
    Orn_Hdl::Model& model = *engine.GetModel("chain");
    // The factory is the engine's: every model of the engine knows the phrase from now on.
    model.GetCommandFactory()->AddCommandCreator("ADD CHAIN", &AddChainCommand::Create);

    try {
        if (!model.Read(argv[1])) {
            std::cerr << "chain: cannot read " << argv[1] << "\n";
            return 1;
        }
        model.Execute("ADD CHAIN BUF L none A Y");
    } catch (const Orn_Hdl::Exception& exception) {
        // The line above has no count: it is refused like any other command.
        std::cout << "refused: " << exception.what();
    }
    PrintVerilog(model);
}
