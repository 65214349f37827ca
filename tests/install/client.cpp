// A program that knows nothing of the library but its headers.

#include <Orn_Hdl/Orn_Hdl.h>

#include <cstring>
#include <iostream>

#ifdef ORN_HDL_STATIC
constexpr const char* Linkage = "static";
#else
constexpr const char* Linkage = "shared";
#endif

int main() {
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel("top", "");
    engine.UseModel("top");
    engine.Execute("ADD COMPONENT INV");
    engine.Execute("ADD PIN INV I input");
    try {
        engine.Execute("ADD INSTANCE NAND U1");
        return 1;
    } catch (const Orn_Hdl::Exception& exception) {
        if (std::strstr(exception.what(), "NAND") == nullptr) {
            return 2;
        }
    }
    engine.Execute("ADD INSTANCE INV U1");

    Orn_Hdl::TextMemOutStream out;
    Orn_Hdl::HdlOptions options;
    options.writeHeader = false;
    Orn_Hdl::VerilogNetlister(out).WriteNetlist(engine.GetModel("top")->GetNetlist(), options);
    if (std::strstr(out.GetValue().CStr(), "INV U1 (.I());") == nullptr) {
        return 3;
    }
    std::cout << Linkage << " C++" << __cplusplus / 100 % 100 << "\n";
}
