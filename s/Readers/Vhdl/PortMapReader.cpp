#include "Readers/Vhdl/PortMapReader.h"

#include "Readers/Vhdl/Types.h"

#include <algorithm>
#include <cstdlib>
#include <iterator>
#include <utility>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

/// How many bits, in words.
std::string BitsOf(std::uint64_t width, bool isVector) {
    return width == 1 ? (isVector ? "a vector of one bit" : "one bit")
                      : std::to_string(width) + " bits";
}

} // namespace

void PortMapReader::Read(const ModuleHead& head, Instance& instance) {
    head_ = &head;
    instance_ = &instance;
    pins_.clear();
    for (Pin* pin : instance.GetPinIterator()) {
        pins_.push_back(pin);
    }
    isConnected_.assign(head.ports.size(), false);
    next_ = 0;
    hasNames_ = false;
    parts_.clear();
    parser_.Next();
    parser_.Expect(Keyword::Map, "map");
    parser_.Expect('(');
    do {
        ReadAssociation();
    } while (parser_.Accept(','));
    EndPort();
    for (std::size_t port = 0; port < head.ports.size(); ++port) {
        if (head.ports[port].hasDefault && !isConnected_[port] &&
            head.ports[port].direction == Polarity::Input) {
            parser_.Fail("the port " + Quoted(head.ports[port].name) +
                         " is open and has a default value, which a model cannot say: connect it");
        }
    }
    parser_.Expect(')');
}

/// "SIGNAL", "PORT => SIGNAL" or "PORT(0) => SIGNAL"
void PortMapReader::ReadAssociation() {
    const Place place = parser_.Get().place;
    const bool hasName = parser_.IsName() && parser_.GetKeyword() == Keyword::None;
    std::optional<Selection> selection;
    if (hasName) {
        name_ = parser_.Get().text;
        parser_.Next();
        if (parser_.IsSign('(')) {
            selection = expressions_.ReadSelection();
            if (!selection) {
                expressions_.RefuseIndex(name_, place);
            }
        }
        if (parser_.Accept(Arrow)) {
            ReadByName(selection, place);
            return;
        }
    }
    ReadByPosition(hasName, selection, place);
}

/// Reads what is connected to the port `name_`, or to a part of it.
void PortMapReader::ReadByName(const std::optional<Selection>& selection, const Place& place) {
    hasNames_ = true;
    const std::size_t port = head_->FindPort(name_, next_);
    if (port >= head_->ports.size()) {
        parser_.Fail(place,
                     "the component " + Quoted(head_->name) + " has no port " + Quoted(name_));
    }
    if (parts_.empty() || port != port_) {
        EndPort();
        BeginPort(port, place);
    }
    if (selection) {
        ReadPart(*selection, place);
        next_ = port;
        return;
    }
    if (!parts_.empty()) {
        parser_.Fail(place, "the port " + Quoted(name_) + " is connected already");
    }
    if (parser_.Accept(Keyword::Open)) {
        isConnected_[port] = !head_->ports[port].hasDefault;
        return;
    }
    const Shape shape{head_->ports[port].range};
    expressions_.Read(value_, &shape);
    CheckWidth(shape.GetWidth(), shape.range.has_value());
    Connect();
}

void PortMapReader::ReadPart(const Selection& selection, const Place& place) {
    const PortHead& port = head_->ports[port_];
    if (!port.range) {
        parser_.Fail(place, "the port " + Quoted(port.name) + " has one bit and no range");
    }
    const Range part = expressions_.CheckSelection(selection, *port.range, port.name);
    if (parser_.GetKeyword() == Keyword::Open) {
        parser_.Fail("a part of the port " + Quoted(port.name) +
                     " that is open: a model's pins are open as a whole");
    }
    Shape shape;
    if (selection.isSlice) {
        shape.range = part;
    }
    expressions_.Read(value_, &shape);
    CheckWidth(part.GetWidth(), selection.isSlice);
    parts_.push_back({part, std::move(value_.pieces), place});
}

/// \param hasName whether it begins with `name_`, which is read.
void PortMapReader::ReadByPosition(bool hasName, const std::optional<Selection>& selection,
                                   const Place& place) {
    if (hasNames_) {
        parser_.Fail(place, "a connection by position behind one by name");
    }
    if (next_ >= head_->ports.size()) {
        parser_.Fail(place, "the component " + Quoted(head_->name) + " has " +
                                std::to_string(head_->ports.size()) + " ports and no further one");
    }
    BeginPort(next_, place);
    if (!hasName && parser_.Accept(Keyword::Open)) {
        isConnected_[port_] = !head_->ports[port_].hasDefault;
        return;
    }
    const Shape shape{head_->ports[port_].range};
    if (!hasName) {
        expressions_.Read(value_, &shape);
    } else if (parser_.IsSign('.') || parser_.IsSign('\'')) {
        parser_.Fail(place, "an expression that begins with " + Quoted(name_) +
                                " in a connection by position: name the port");
    } else {
        expressions_.ReadBehind(value_, name_, selection ? &*selection : nullptr, place);
    }
    CheckWidth(shape.GetWidth(), shape.range.has_value());
    Connect();
}

void PortMapReader::BeginPort(std::size_t port, const Place& place) {
    if (isConnected_[port]) {
        parser_.Fail(place,
                     "the port " + Quoted(head_->ports[port].name) + " is connected already");
    }
    isConnected_[port] = true;
    port_ = port;
    next_ = port + 1;
}

/// Connects the parts of a port, all of which are read.
void PortMapReader::EndPort() {
    if (parts_.empty()) {
        return;
    }
    const PortHead& port = head_->ports[port_];
    const Range& whole = *port.range;
    const auto positionOf = [&whole](const Part& part) {
        return std::abs(std::int64_t(part.range.left) - whole.left);
    };
    std::stable_sort(parts_.begin(), parts_.end(), [&positionOf](const Part& a, const Part& b) {
        return positionOf(a) < positionOf(b);
    });
    value_.Clear(parts_.front().place);
    value_.isVector = true;
    std::uint64_t end = 0;
    for (Part& part : parts_) {
        const auto begin = static_cast<std::uint64_t>(positionOf(part));
        if (begin < end) {
            parser_.Fail(part.place,
                         "a part of the port " + Quoted(port.name) + " is connected twice");
        }
        end = begin + part.range.GetWidth();
        value_.width += part.range.GetWidth();
        std::move(part.pieces.begin(), part.pieces.end(), std::back_inserter(value_.pieces));
    }
    if (value_.width < whole.GetWidth()) {
        parser_.Fail(value_.place, "a part of the port " + Quoted(port.name) +
                                       " is not connected: a model's pins are open as a whole");
    }
    parts_.clear();
    Connect();
}

/// Refuses a value that does not have the type of a port or of a part of one.
void PortMapReader::CheckWidth(std::uint64_t width, bool isVector) const {
    if (value_.width != width || value_.isVector != isVector) {
        parser_.Fail(value_.place, "the port " + Quoted(head_->ports[port_].name) + " of " +
                                       Quoted(head_->name) + " takes " + BitsOf(width, isVector) +
                                       " here, and not " + BitsOf(value_.width, value_.isVector));
    }
}

/// Connects what was read to the pin of the present port.
void PortMapReader::Connect() {
    NetlistSink* const sink = maker_.GetSink();
    if (value_.IsConstant()) {
        if (head_->ports[port_].direction != Polarity::Input) {
            parser_.Fail(value_.place, "a constant at the port " +
                                           Quoted(head_->ports[port_].name) +
                                           ", which is no input");
        }
        if (sink != nullptr) {
            sink->ConnectConstant(head_->ports[port_], value_.place);
        } else {
            maker_.ConnectConstant(*instance_, *pins_[port_], value_.GetConstant());
        }
        return;
    }
    if (sink != nullptr) {
        sink->Connect(head_->ports[port_], maker_.GetMembers(value_.pieces), value_.place);
        return;
    }
    Signal* const signal = maker_.GetSignal(value_.pieces);
    if (NetlistMaker::IsOpenWord(signal->GetNameView())) {
        parser_.Fail(value_.place,
                     "a signal of this name, which stands for an open pin in a model");
    }
    signal->Connect(pins_[port_]);
}

} // namespace Orn_Hdl::Readers::Vhdl
