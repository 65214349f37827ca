// The parameters and attributes of a design, compared with those of a netlist.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Proof/Findings.h"
#include "Readers/Heads.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Orn_Hdl::Proving {

class Parameters {
public:
    Parameters(const Netlist& design, const HdlOptions& options, Findings& findings);

    /// Expects the attributes of a signal, behind those of the signals before it.
    void AddSignal(const Signal& signal);
    /// Expects the parameters and attributes of an instance from now on.
    void BeginInstance(const Instance& instance);
    /// \{
    /// Takes what the netlist gives to the module, the present instance, or a signal.
    void TakeOfModule(const std::string& name, const Readers::Value& value, bool isHidden,
                      const Readers::Place& place);
    void TakeOfInstance(const std::string& name, const Readers::Value& value, bool isHidden,
                        const Readers::Place& place);
    void TakeAttribute(const std::string& name, const Readers::Value& value,
                       const Readers::Place& place);
    void TakeAttribute(const Signal& signal, const std::string& name, const Readers::Value& value,
                       const Readers::Place& place);
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

    void ExpectParameters(const std::vector<const Attribute*>& attributes, Expected& expected);
    void Take(Expected& expected, const Instance* instance, const std::string& name,
              const Readers::Value& value, bool isHidden, const Readers::Place& place);
    bool IsSameText(const Attribute& attribute, const Readers::Value& value) const;
    const Attribute& ValueOf(const Attribute& attribute) const;
    Cause CauseOf(const Instance* instance, const Attribute* attribute) const;
    Cause CauseOf(const Signal& signal, const Attribute& attribute) const;
    void ReportLeft(const Expected& expected, const char* what, const Readers::Place& place);

    const HdlOptions& options_;
    Findings& findings_;
    const std::string moduleName_;
    Expected ofModule_;
    const Instance* instance_ = nullptr;
    Expected ofInstance_;
    Expected attributes_;
    std::vector<OfSignal> ofSignals_;
    std::size_t readOfSignals_ = 0;
    /// The parameter of the module that its instances get; null for none.
    const Attribute* passed_ = nullptr;
    std::vector<const Attribute*> effective_;
};

} // namespace Orn_Hdl::Proving
