// The parameters and attributes of a design, compared with those of a netlist.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Proof/Findings.h"
#include "Readers/NetlistSink.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Proving {

class Parameters {
public:
    Parameters(const Netlist& design, const HdlOptions& options, Language language,
               Findings& findings);

    /// Expects the attributes of a signal, behind those of the signals before it.
    void AddSignal(const Signal& signal);
    /// Expects the parameters and attributes of a component, the attributes yet to come.
    void BeginComponent(const Component& component, const Readers::ModuleHead& head,
                        const Readers::Place& place);
    /// Expects the parameters and attributes of an instance from now on. In VHDL, the attributes
    /// are those of the architecture, which come before.
    void BeginInstance(const Instance& instance);
    /// \{
    /// Takes what the netlist gives to the module, the present instance, or a signal.
    void TakeOfModule(const std::string& name, const Readers::Value& value, bool isHidden,
                      const Readers::Place& place);
    void TakeOfInstance(const std::string& name, const Readers::Value& value, bool isHidden,
                        const Readers::Place& place);
    void TakeAttribute(const Readers::Owner& owner, const std::string& name,
                       const Readers::Value& value, bool isDeclared, const Readers::Place& place);
    void TakeAttribute(const Signal& signal, const std::string& name, const Readers::Value& value,
                       bool isDeclared, const Readers::Place& place);
    /// \}
    /// Reports what the instance has not got. \param place where it ends.
    void EndInstance(const Readers::Place& place);
    /// Reports what the module and the signals have not got. \param place where the module ends.
    void End(const Readers::Place& place);

private:
    /// What one object has to get, in order, and how much of it was read.
    struct Expected {
        std::vector<const Attribute*> attributes;
        std::size_t read = 0;

        void Clear() {
            attributes.clear();
            read = 0;
        }
        const Attribute* TakeNext() {
            return read < attributes.size() ? attributes[read++] : nullptr;
        }
    };
    struct OfSignal {
        const Signal* signal;
        const Attribute* attribute;
    };

    /// The object that has parameters and attributes.
    struct Holder {
        const Component* component = nullptr;
        const Instance* instance = nullptr;

        std::string GetName() const;
    };
    struct OfInstance {
        const Instance* instance;
        const Attribute* attribute;
    };

    void ExpectParameters(const std::vector<const Attribute*>& attributes, Expected& expected);
    void ExpectOfInstances();
    void Take(Expected& expected, const Holder& holder, const std::string& name,
              const Readers::Value& value, bool isHidden, const Readers::Place& place);
    void CompareAttribute(const Holder& holder, const Attribute* attribute, const std::string& name,
                          const Readers::Value& value, bool isDeclared,
                          const Readers::Place& place);
    bool IsNamed(const Attribute& attribute, std::string_view name) const;
    bool IsSame(const Attribute& attribute, const Readers::Value& value) const;
    Cause CauseOf(const Holder& holder, const Attribute* attribute) const;
    Cause CauseOf(const Signal& signal, const Attribute& attribute) const;
    void ReportLeft(const Expected& expected, const Holder& holder, const char* what,
                    const Readers::Place& place);

    const Netlist& design_;
    const HdlOptions& options_;
    const Language language_;
    Findings& findings_;
    const std::string moduleName_;
    Expected ofModule_;
    /// The present component or instance.
    Holder holder_;
    Expected ofHolder_;
    Expected attributes_;
    /// \{
    /// In VHDL, the attributes of all instances; made when the first one is read.
    std::vector<OfInstance> ofInstances_;
    std::size_t readOfInstances_ = 0;
    bool hasOfInstances_ = false;
    /// \}
    std::vector<OfSignal> ofSignals_;
    std::size_t readOfSignals_ = 0;
    /// The parameter of the module that its instances get; null for none.
    const Attribute* passed_ = nullptr;
    std::vector<const Attribute*> effective_;
};

} // namespace Orn_Hdl::Proving
