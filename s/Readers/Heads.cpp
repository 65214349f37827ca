#include "Readers/Heads.h"

#include "Orn_Hdl/Model/Netlist.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <charconv>

namespace Orn_Hdl::Readers {

namespace {

/// Takes an integer off the front of a text, and the character behind it.
int TakeInteger(std::string_view& text) {
    int value = 0;
    text.remove_prefix(!text.empty() && text.front() == '+' ? 1 : 0);
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    const auto length = static_cast<std::size_t>(result.ptr - text.data());
    text.remove_prefix(std::min(length + 1, text.size()));
    return value;
}

PortHead MakePort(const Pin& pin, std::string_view (*toFile)(std::string_view name)) {
    PortHead port;
    std::string_view name = pin.GetNameView();
    port.direction = pin.GetPolarity().GetValue();
    const std::size_t parenthesis = name.find('(');
    port.name = toFile(name.substr(0, parenthesis));
    if (pin.GetPinType() == PinTypeBus) {
        name.remove_prefix(parenthesis + 1);
        const int left = TakeInteger(name);
        port.range = Range{left, TakeInteger(name)};
    } else if (pin.GetPinType() == PinTypeBusIndex) {
        port.problem = "it is one bit of several that are pins of their own";
    }
    return port;
}

} // namespace

bool IsExtended(std::string_view name) noexcept {
    return name.size() > 1 && name.front() == '\\' && name.back() == '\\';
}

bool IsSameName(std::string_view a, std::string_view b, bool ignoresCase) noexcept {
    return a == b || (ignoresCase && !IsExtended(a) && Port::EqualIgnoringCase(a, b));
}

bool Heads::NameOrder::operator()(std::string_view a, std::string_view b) const noexcept {
    if (!ignoresCase || IsExtended(a) || IsExtended(b)) {
        return a < b;
    }
    return Port::OrderIgnoringCase(a, b) < 0;
}

PortHead* ModuleHead::FindPort(std::string_view portName) noexcept {
    const std::size_t index = FindPort(portName, 0);
    return index < ports.size() ? &ports[index] : nullptr;
}

std::size_t ModuleHead::FindPort(std::string_view portName, std::size_t hint) const noexcept {
    if (hint < ports.size() && IsSameName(ports[hint].name, portName, ignoresCase)) {
        return hint;
    }
    const auto found =
        std::find_if(ports.begin(), ports.end(), [this, portName](const PortHead& port) {
            return IsSameName(port.name, portName, ignoresCase);
        });
    return static_cast<std::size_t>(found - ports.begin());
}

const ParameterHead* ModuleHead::FindParameter(std::string_view parameterName) const noexcept {
    const auto found =
        std::find_if(parameters.begin(), parameters.end(),
                     [this, parameterName](const ParameterHead& parameter) {
                         return IsSameName(parameter.name, parameterName, ignoresCase);
                     });
    return found == parameters.end() ? nullptr : &*found;
}

ModuleHead* Heads::Find(std::string_view name) const {
    const auto found = byName_.find(name);
    return found == byName_.end() ? nullptr : found->second;
}

ModuleHead* Heads::Add(std::string_view name, const Place& place) {
    if (Find(name) != nullptr) {
        return nullptr;
    }
    auto head = std::make_unique<ModuleHead>();
    head->name = name;
    head->place = place;
    head->ignoresCase = ignoresCase_;
    heads_.push_back(std::move(head));
    ModuleHead* const added = heads_.back().get();
    byName_.emplace(added->name, added);
    return added;
}

void Heads::Add(const Netlist& netlist, std::string_view (*toFile)(std::string_view name)) {
    for (const Component* component : netlist.GetComponentIterator()) {
        ModuleHead* const head =
            component == nullptr ? nullptr : Add(toFile(component->GetNameView()), Place());
        if (head == nullptr) {
            continue;
        }
        head->hasParameters = false;
        for (const Pin* pin : component->GetPinIterator()) {
            head->ports.push_back(MakePort(*pin, toFile));
        }
    }
}

} // namespace Orn_Hdl::Readers
