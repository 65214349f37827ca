#include "diff/Compare.h"

#include "diff/Attributes.h"
#include "diff/Names.h"
#include "diff/SignalPairs.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Tool::Diff {

namespace {

using Orn_Hdl::Attribute;
using Orn_Hdl::Component;
using Orn_Hdl::Instance;
using Orn_Hdl::Netlist;
using Orn_Hdl::Object;
using Orn_Hdl::Pin;
using Orn_Hdl::Signal;
using Cause = Orn_Hdl::Check::Cause;
using Kind = Cause::Kind;

std::string NameOf(const Object& object) {
    return std::string(WithoutEscape(object.GetNameView()));
}

Cause MakeCause(Kind kind, std::string first = {}, std::string second = {}) {
    Cause cause;
    cause.kind = kind;
    cause.first = std::move(first);
    cause.second = std::move(second);
    return cause;
}

bool HaveSameName(const Object& a, const Object& b) {
    return Port::EqualIgnoringCase(WithoutEscape(a.GetNameView()), WithoutEscape(b.GetNameView()));
}

/// A comment as one line.
std::string DescribeComment(std::string_view comment) {
    std::string text;
    for (const char c : comment.substr(0, comment.find_last_not_of('\n') + 1)) {
        text.append(c == '\n' ? " / " : std::string(1, c));
    }
    return text;
}

const char* DescribeDirection(const Orn_Hdl::Polarity& polarity) {
    return polarity.IsValid() ? polarity.GetValueName() : "none";
}

/// Compares two designs with the matching that `byNames` asks for.
class Comparison {
public:
    Comparison(const Netlist& a, const Netlist& b, const Rules& rules, std::size_t most)
        : netlists_{&a, &b}, rules_(rules), most_(most),
          components_(a, b), graphs_{Graph(a, A, components_, rules),
                                     Graph(b, B, components_, rules)},
          likeness_{GetLikeness(graphs_[A], rules), GetLikeness(graphs_[B], rules)}, found_(most) {}

    Differences Run(bool byNames);

private:
    /// An object of both designs, for what is compared alike on all kinds.
    struct Holder {
        /// What stands behind the name of an attribute and "of", such as "signal N".
        std::string titles[2];
        /// What brought an attribute in; the name of the attribute is added unless the cause has
        /// two names.
        Cause causes[2];
    };

    const InstanceRow& Row(Design design, std::uint32_t row) const {
        return graphs_[design].GetInstances()[row];
    }

    bool ComparesNetNames() const noexcept { return rules_.names && !rules_.mergesNets; }
    void CompareModule();
    void CompareComponents();
    void CompareComponent(const PairedComponent& pair);
    void CompareComponentPin(const PairedComponent& pair, const PairedPin& pin);
    void ComparePinOrder(const PairedComponent& pair);
    void ComparePortOrder(const SignalPairs& pairs);
    void CompareSignals(bool byNames);
    void CompareSignal(const SignalPairs::Pair& pair);
    void CompareShape(const SignalRow& a, const SignalRow& b);
    void CompareTies(const SignalRow& a, const SignalRow& b, bool isRenamed);
    bool IsLost(Design design, const SignalPairs::Part& part) const;
    void AddPart(Design design, const SignalPairs::Part& part);
    void AddBitPair(const SignalPairs::BitPair& bits);
    void CompareInstances();
    void CompareInstance(const Instance& a, const Instance& b, std::uint32_t rowA,
                         std::uint32_t rowB);
    void CompareConnections(std::uint32_t rowA, std::uint32_t rowB);
    void CompareConnectionsByName(std::uint32_t rowA, std::uint32_t rowB);
    void CompareInstancePins(const Instance& a, const Instance& b);
    bool AreEqualNets(std::uint32_t netA, std::uint32_t netB, bool& isTie) const;
    void AddConnection(Change change, const Pin* pinA, const Pin* pinB, const Instance& a,
                       const Instance& b);
    void CompareAliases();
    void AddAlias(Change change, const AliasRow* a, const AliasRow* b);
    void CompareAttributes(const AttributeList& a, const AttributeList& b, const Holder& holder);
    void CompareComments(const Object& a, const Object& b, const Holder& holder);
    void AddMissing(Design design, Thing thing, const Object& object, Cause cause);

    const Netlist* netlists_[2];
    const Rules rules_;
    const std::size_t most_;
    Components components_;
    Graph graphs_[2];
    Likeness likeness_[2];
    Matching matching_{graphs_[A], graphs_[B]};
    Differences found_;
};

Differences Comparison::Run(bool byNames) {
    found_ = Differences(most_);
    matching_ = Match(graphs_[A], graphs_[B], likeness_, byNames, rules_.mergesNets);
    CompareModule();
    CompareComponents();
    CompareSignals(byNames);
    CompareInstances();
    CompareAliases();
    return std::move(found_);
}

/// An object that only one design has.
void Comparison::AddMissing(Design design, Thing thing, const Object& object, Cause cause) {
    const Change change = design == A ? Change::Removed : Change::Added;
    if (found_.Count(change)) {
        Difference difference;
        difference.change = change;
        difference.thing = thing;
        Side& side = design == A ? difference.a : difference.b;
        side.name = NameOf(object);
        side.cause = std::move(cause);
        found_.Keep(std::move(difference));
    }
}

void Comparison::CompareAttributes(const AttributeList& a, const AttributeList& b,
                                   const Holder& holder) {
    for (const auto& [inA, inB] : Diff::CompareAttributes(a, b, rules_)) {
        const Change change = inB == nullptr   ? Change::Removed
                              : inA == nullptr ? Change::Added
                                               : Change::Changed;
        if (!found_.Count(change)) {
            continue;
        }
        Difference difference;
        difference.change = change;
        difference.thing = Thing::Attribute;
        const auto describe = [&](Design design, const Attribute* attribute, Side& side) {
            if (attribute != nullptr) {
                side.name = NameOf(*attribute) + " of " + holder.titles[design];
                side.text = DescribeAttribute(*attribute, rules_);
                side.cause = holder.causes[design];
                if (side.cause.second.empty()) {
                    side.cause.second = NameOf(*attribute);
                }
            }
        };
        describe(A, inA, difference.a);
        describe(B, inB, difference.b);
        found_.Keep(std::move(difference));
    }
}

void Comparison::CompareComments(const Object& a, const Object& b, const Holder& holder) {
    if (!rules_.comments || a.GetCommentView() == b.GetCommentView()) {
        return;
    }
    const bool isAdded = a.GetCommentView().empty();
    const bool isRemoved = b.GetCommentView().empty();
    const Change change = isAdded ? Change::Added : isRemoved ? Change::Removed : Change::Changed;
    if (!found_.Count(change)) {
        return;
    }
    Difference difference;
    difference.change = change;
    difference.thing = Thing::Comment;
    const auto describe = [&](Design design, const Object& object, Side& side) {
        const std::string_view comment = object.GetCommentView();
        if (!comment.empty()) {
            side.name = "of " + holder.titles[design];
            side.text = DescribeComment(comment);
            side.cause =
                MakeCause(Kind::Comment, std::string(comment.substr(0, comment.find('\n'))));
        }
    };
    describe(A, a, difference.a);
    describe(B, b, difference.b);
    found_.Keep(std::move(difference));
}

void Comparison::CompareModule() {
    const Netlist& a = *netlists_[A];
    const Netlist& b = *netlists_[B];
    if (rules_.names && rules_.hasDesignName && !HaveSameName(a, b) &&
        found_.Count(Change::Renamed)) {
        Difference difference;
        difference.change = Change::Renamed;
        difference.a = {NameOf(a), "", MakeCause(Kind::DesignName)};
        difference.b = {NameOf(b), "", MakeCause(Kind::DesignName)};
        found_.Keep(std::move(difference));
    }
    const Holder holder{{"the module", "the module"},
                        {MakeCause(Kind::ModuleAttribute), MakeCause(Kind::ModuleAttribute)}};
    if (rules_.attributes) {
        CompareAttributes(ListAttributes(a, rules_), ListAttributes(b, rules_), holder);
    }
    CompareComments(a, b, holder);
}

void Comparison::CompareComponents() {
    for (const PairedComponent& pair : components_.GetAll()) {
        if (pair.IsIn(A) && pair.IsIn(B)) {
            CompareComponent(pair);
            continue;
        }
        for (const Design design : {A, B}) {
            if (pair.IsIn(design) && (rules_.hasUnusedParts || pair.instances[design] > 0)) {
                const Component& component = *pair.components[design];
                AddMissing(design, Thing::Component, component,
                           MakeCause(Kind::Component, NameOf(component)));
            }
        }
    }
}

void Comparison::CompareComponent(const PairedComponent& pair) {
    const Component& a = *pair.components[A];
    const Component& b = *pair.components[B];
    if (pair.isRenamed && found_.Count(Change::Renamed)) {
        Difference difference;
        difference.change = Change::Renamed;
        difference.thing = Thing::Component;
        difference.a = {NameOf(a), "", MakeCause(Kind::Component, NameOf(a))};
        difference.b = {NameOf(b), "", MakeCause(Kind::Component, NameOf(b))};
        found_.Keep(std::move(difference));
    }
    if (!rules_.hasUnusedParts && pair.instances[A] == 0 && pair.instances[B] == 0) {
        return;
    }
    for (const PairedPin& pin : pair.pins) {
        CompareComponentPin(pair, pin);
    }
    if (rules_.order && rules_.hasPinRanges) {
        ComparePinOrder(pair);
    }
    const Holder holder{{"component " + NameOf(a), "component " + NameOf(b)},
                        {MakeCause(Kind::ComponentAttribute, NameOf(a)),
                         MakeCause(Kind::ComponentAttribute, NameOf(b))}};
    if (rules_.attributes && rules_.hasExactAttributes) {
        CompareAttributes(ListAttributes(a, rules_), ListAttributes(b, rules_), holder);
    }
    CompareComments(a, b, holder);
}

void Comparison::CompareComponentPin(const PairedComponent& pair, const PairedPin& pin) {
    const auto describe = [&](Design design, Side& side) {
        const Component& owner = *pair.components[design];
        side.name = NameOf(owner) + "." + NameOf(*pin.pins[design]);
        side.cause = MakeCause(Kind::Pin, NameOf(owner), NameOf(*pin.pins[design]));
    };
    Difference difference;
    difference.thing = Thing::ComponentPin;
    for (const Design design : {A, B}) {
        if (pin.pins[Other(design)] != nullptr) {
            continue;
        }
        if (!rules_.hasUnusedParts && !pin.isUsed[design]) {
            return;
        }
        difference.change = design == A ? Change::Removed : Change::Added;
        if (found_.Count(difference.change)) {
            describe(design, design == A ? difference.a : difference.b);
            found_.Keep(std::move(difference));
        }
        return;
    }
    const Pin& a = *pin.pins[A];
    const Pin& b = *pin.pins[B];
    const auto add = [&](const char* what, std::string textA, std::string textB) {
        if (found_.Count(Change::Changed)) {
            Difference changed;
            changed.thing = Thing::ComponentPin;
            changed.what = what;
            describe(A, changed.a);
            describe(B, changed.b);
            changed.a.text = std::move(textA);
            changed.b.text = std::move(textB);
            found_.Keep(std::move(changed));
        }
    };
    if (a.GetPolarity() != b.GetPolarity()) {
        add("direction", DescribeDirection(a.GetPolarity()), DescribeDirection(b.GetPolarity()));
    }
    const bool hasSameRange = rules_.hasPinRanges
                                  ? HaveSameName(a, b)
                                  : a.GetPinType() == b.GetPinType() || pin.width == 1;
    if (!hasSameRange) {
        add("range", NameOf(a), NameOf(b));
    }
    if (rules_.hasExactAttributes &&
        a.GetDefaultValue().GetValue() != b.GetDefaultValue().GetValue()) {
        add("default value", std::string(a.GetDefaultValue().GetValue().GetView()),
            std::string(b.GetDefaultValue().GetValue().GetView()));
    }
    const Holder holder{{"pin " + NameOf(*pair.components[A]) + "." + NameOf(a),
                         "pin " + NameOf(*pair.components[B]) + "." + NameOf(b)},
                        {MakeCause(Kind::Pin, NameOf(*pair.components[A]), NameOf(a)),
                         MakeCause(Kind::Pin, NameOf(*pair.components[B]), NameOf(b))}};
    if (rules_.attributes && rules_.hasExactAttributes) {
        CompareAttributes(ListAttributes(a, rules_), ListAttributes(b, rules_), holder);
    }
    CompareComments(a, b, holder);
}

/// Tells the first pin that stands at another place, of those that both have.
void Comparison::ComparePinOrder(const PairedComponent& pair) {
    std::vector<const PairedPin*> inA;
    for (const PairedPin& pin : pair.pins) {
        if (pin.pins[A] != nullptr && pin.pins[B] != nullptr) {
            inA.push_back(&pin);
        }
    }
    std::size_t at = 0;
    for (const Pin* pin : pair.components[B]->GetPinIterator()) {
        const auto isThis = [pin](const PairedPin* paired) { return paired->pins[B] == pin; };
        if (at < inA.size() && isThis(inA[at])) {
            ++at;
        } else if (std::any_of(inA.begin() + static_cast<std::ptrdiff_t>(at), inA.end(), isThis)) {
            if (found_.Count(Change::Changed)) {
                Difference difference;
                difference.thing = Thing::Component;
                difference.what = "order of pins at pin " + std::to_string(at + 1);
                const Component& a = *pair.components[A];
                const Component& b = *pair.components[B];
                difference.a = {NameOf(a), NameOf(*inA[at]->pins[A]),
                                MakeCause(Kind::Component, NameOf(a))};
                difference.b = {NameOf(b), NameOf(*pin), MakeCause(Kind::Component, NameOf(b))};
                found_.Keep(std::move(difference));
            }
            return;
        }
    }
}

void Comparison::ComparePortOrder(const SignalPairs& pairs) {
    std::vector<std::uint32_t> order[2];
    for (const SignalPairs::Pair& pair : pairs.pairs) {
        if (graphs_[A].GetSignals()[pair.rows[A]].isPort &&
            graphs_[B].GetSignals()[pair.rows[B]].isPort) {
            order[A].push_back(pair.rows[A]);
            order[B].push_back(pair.rows[B]);
        }
    }
    const std::vector<std::uint32_t> partners = order[B];
    std::vector<std::pair<std::uint32_t, std::uint32_t>> inA;
    for (std::size_t i = 0; i < order[A].size(); ++i) {
        inA.emplace_back(order[A][i], partners[i]);
    }
    std::sort(inA.begin(), inA.end());
    std::sort(order[B].begin(), order[B].end());
    for (std::size_t i = 0; i < inA.size(); ++i) {
        if (inA[i].second == order[B][i]) {
            continue;
        }
        if (found_.Count(Change::Changed)) {
            const Signal& a = *graphs_[A].GetSignals()[inA[i].first].signal;
            const Signal& b = *graphs_[B].GetSignals()[order[B][i]].signal;
            Difference difference;
            difference.what = "order of ports at port " + std::to_string(i + 1);
            difference.a = {NameOf(*netlists_[A]), NameOf(a), MakeCause(Kind::Signal, NameOf(a))};
            difference.b = {NameOf(*netlists_[B]), NameOf(b), MakeCause(Kind::Signal, NameOf(b))};
            found_.Keep(std::move(difference));
        }
        return;
    }
}

void Comparison::AddPart(Design design, const SignalPairs::Part& part) {
    const SignalRow& row = graphs_[design].GetSignals()[part.row];
    const Change change = design == A ? Change::Removed : Change::Added;
    if (!found_.Count(change)) {
        return;
    }
    Difference difference;
    difference.change = change;
    difference.thing = row.isPort ? Thing::Port : Thing::Signal;
    Side& side = design == A ? difference.a : difference.b;
    side.name = part.index == SignalPairs::Part::Whole ? NameOf(*row.signal)
                                                       : Graph::GetBitName(row, part.index);
    side.cause = MakeCause(Kind::Signal, NameOf(*row.signal));
    found_.Keep(std::move(difference));
}

void Comparison::AddBitPair(const SignalPairs::BitPair& bits) {
    const SignalRow* rows[2] = {&graphs_[A].GetSignals()[bits.parts[A].row],
                                &graphs_[B].GetSignals()[bits.parts[B].row]};
    Difference difference;
    difference.thing = Thing::Signal;
    const auto describe = [&](Design design, Side& side) {
        side.name = Graph::GetBitName(*rows[design], bits.parts[design].index);
        side.cause = MakeCause(Kind::Signal, NameOf(*rows[design]->signal));
    };
    if (ComparesNetNames() && found_.Count(Change::Renamed)) {
        difference.change = Change::Renamed;
        describe(A, difference.a);
        describe(B, difference.b);
        found_.Keep(difference);
    }
    std::uint32_t ties[2] = {};
    for (const Design design : {A, B}) {
        const std::uint32_t net =
            graphs_[design].GetNet(rows[design]->first + bits.parts[design].index);
        ties[design] = net == Open ? Graph::Untied : graphs_[design].GetTie(net);
    }
    if (ties[A] != ties[B] && found_.Count(Change::Retied)) {
        difference.change = Change::Retied;
        describe(A, difference.a);
        describe(B, difference.b);
        found_.Keep(std::move(difference));
    }
}

/// Whether a signal is a port, or has a net that the other design does not have.
bool Comparison::IsLost(Design design, const SignalPairs::Part& part) const {
    const Graph& graph = graphs_[design];
    const SignalRow& row = graph.GetSignals()[part.row];
    const bool isWhole = part.index == SignalPairs::Part::Whole;
    for (std::uint32_t i = isWhole ? 0 : part.index; i < (isWhole ? row.count : part.index + 1);
         ++i) {
        const std::uint32_t net = graph.GetNet(row.first + i);
        if (net != Open && graph.IsWired(net) && matching_.nets[design][net] == None) {
            return true;
        }
    }
    return row.isPort;
}

void Comparison::CompareSignals(bool byNames) {
    const SignalPairs pairs =
        PairSignals(graphs_[A], graphs_[B], matching_, byNames, rules_.mergesNets);
    for (const SignalPairs::Pair& pair : pairs.pairs) {
        CompareSignal(pair);
    }
    for (const SignalPairs::BitPair& bits : pairs.bits) {
        AddBitPair(bits);
    }
    for (const Design design : {A, B}) {
        for (const SignalPairs::Part& part : pairs.left[design]) {
            if (!rules_.mergesNets || IsLost(design, part)) {
                AddPart(design, part);
            }
        }
    }
    if (rules_.order && rules_.hasPortOrder) {
        ComparePortOrder(pairs);
    }
}

void Comparison::CompareSignal(const SignalPairs::Pair& pair) {
    const SignalRow& a = graphs_[A].GetSignals()[pair.rows[A]];
    const SignalRow& b = graphs_[B].GetSignals()[pair.rows[B]];
    if (pair.isRenamed && ComparesNetNames() && found_.Count(Change::Renamed)) {
        Difference difference;
        difference.change = Change::Renamed;
        difference.thing = Thing::Signal;
        difference.a = {NameOf(*a.signal), "", MakeCause(Kind::Signal, NameOf(*a.signal))};
        difference.b = {NameOf(*b.signal), "", MakeCause(Kind::Signal, NameOf(*b.signal))};
        found_.Keep(std::move(difference));
    }
    CompareShape(a, b);
    CompareTies(a, b, pair.isRenamed);
    const char* const thing = a.isPort ? "port " : "signal ";
    const bool hasAttributes = a.signal->HasAttrs() || b.signal->HasAttrs();
    const bool hasComment =
        !a.signal->GetCommentView().empty() || !b.signal->GetCommentView().empty();
    if (!hasAttributes && !hasComment) {
        return;
    }
    const Holder holder{{thing + NameOf(*a.signal), thing + NameOf(*b.signal)},
                        {MakeCause(Kind::SignalAttribute, NameOf(*a.signal)),
                         MakeCause(Kind::SignalAttribute, NameOf(*b.signal))}};
    if (rules_.attributes) {
        CompareAttributes(ListAttributes(*a.signal, rules_), ListAttributes(*b.signal, rules_),
                          holder);
    }
    CompareComments(*a.signal, *b.signal, holder);
}

/// Direction and range. The range of an internal signal is a part of its name.
void Comparison::CompareShape(const SignalRow& a, const SignalRow& b) {
    const auto add = [&](const char* what, std::string textA, std::string textB) {
        if (found_.Count(Change::Changed)) {
            Difference difference;
            difference.thing = a.isPort || b.isPort ? Thing::Port : Thing::Signal;
            difference.what = what;
            difference.a = {NameOf(*a.signal), std::move(textA),
                            MakeCause(Kind::Signal, NameOf(*a.signal))};
            difference.b = {NameOf(*b.signal), std::move(textB),
                            MakeCause(Kind::Signal, NameOf(*b.signal))};
            found_.Keep(std::move(difference));
        }
    };
    if (a.signal->GetPortPolarity() != b.signal->GetPortPolarity()) {
        add("direction", DescribeDirection(a.signal->GetPortPolarity()),
            DescribeDirection(b.signal->GetPortPolarity()));
    }
    const bool isPort = a.isPort || b.isPort;
    const bool hasOneBit = !rules_.hasPinRanges && a.count == 1 && b.count == 1;
    if ((isPort || ComparesNetNames()) && !hasOneBit &&
        (a.isBus != b.isBus || a.left != b.left || a.right != b.right)) {
        const auto describe = [](const SignalRow& row) {
            return row.isBus
                       ? "(" + std::to_string(row.left) + ":" + std::to_string(row.right) + ")"
                       : std::string("none");
        };
        add("range", describe(a), describe(b));
    }
}

void Comparison::CompareTies(const SignalRow& a, const SignalRow& b, bool isRenamed) {
    const auto tieOf = [&](Design design, const SignalRow& row, std::uint32_t i) {
        const std::uint32_t net = graphs_[design].GetNet(row.first + i);
        return net == Open ? Graph::Untied : graphs_[design].GetTie(net);
    };
    // A renamed signal has the same bits at the same places.
    bool areEqual = true;
    for (std::uint32_t i = 0; i < a.count; ++i) {
        const std::uint32_t bit = isRenamed ? b.first + i : Graph::FindBit(a, i, b);
        areEqual = areEqual && (bit == None || tieOf(A, a, i) == tieOf(B, b, bit - b.first));
    }
    if (areEqual || !found_.Count(Change::Retied)) {
        return;
    }
    const auto describe = [&](Design design, const SignalRow& row) {
        std::string text;
        bool isTied = false;
        for (std::uint32_t i = 0; i < row.count; ++i) {
            const std::uint32_t tie = tieOf(design, row, i);
            isTied = isTied || tie != Graph::Untied;
            text += tie == Graph::Untied           ? '-'
                    : tie == Graph::TiedToZero     ? '0'
                    : tie == Graph::TiedToOne      ? '1'
                    : tie == Graph::TiedToDontCare ? 'x'
                                                   : '?';
        }
        const std::string own(row.signal->GetConstantValue().GetValue().GetView());
        return !isTied                                               ? std::string("nothing")
               : text.find('?') != std::string::npos && !own.empty() ? own
                                                                     : text;
    };
    Difference difference;
    difference.change = Change::Retied;
    difference.thing = a.isPort ? Thing::Port : Thing::Signal;
    difference.a = {NameOf(*a.signal), describe(A, a),
                    MakeCause(Kind::Constant, NameOf(*a.signal))};
    difference.b = {NameOf(*b.signal), describe(B, b),
                    MakeCause(Kind::Constant, NameOf(*b.signal))};
    found_.Keep(std::move(difference));
}

void Comparison::CompareInstances() {
    for (const Design design : {A, B}) {
        for (std::uint32_t row = 0; row < graphs_[design].GetInstanceCount(); ++row) {
            const Instance& instance = *Row(design, row).instance;
            const std::uint32_t other = matching_.instances[design][row];
            if (other == None) {
                AddMissing(design, Thing::Instance, instance,
                           MakeCause(Kind::Instance, NameOf(instance)));
            } else if (design == A) {
                CompareInstance(instance, *Row(B, other).instance, row, other);
            }
        }
    }
}

void Comparison::CompareInstance(const Instance& a, const Instance& b, std::uint32_t rowA,
                                 std::uint32_t rowB) {
    const auto add = [&](Change change, const char* what, std::string textA, std::string textB) {
        if (found_.Count(change)) {
            Difference difference;
            difference.change = change;
            difference.thing = Thing::Instance;
            difference.what = what;
            difference.a = {NameOf(a), std::move(textA), MakeCause(Kind::Instance, NameOf(a))};
            difference.b = {NameOf(b), std::move(textB), MakeCause(Kind::Instance, NameOf(b))};
            found_.Keep(std::move(difference));
        }
    };
    if (rules_.names && !HaveSameName(a, b)) {
        add(Change::Renamed, "", "", "");
    }
    if (Row(A, rowA).component != Row(B, rowB).component) {
        add(Change::Changed, "component", std::string(a.GetComponentName().GetView()),
            std::string(b.GetComponentName().GetView()));
        CompareConnectionsByName(rowA, rowB);
    } else {
        CompareConnections(rowA, rowB);
    }
    const bool mayInherit = !rules_.hasExactAttributes &&
                            ((a.GetComponent() != nullptr && a.GetComponent()->HasAttrs()) ||
                             (b.GetComponent() != nullptr && b.GetComponent()->HasAttrs()));
    if (rules_.attributes && (a.HasAttrs() || b.HasAttrs() || mayInherit)) {
        const Holder holder{{"instance " + NameOf(a), "instance " + NameOf(b)},
                            {MakeCause(Kind::InstanceAttribute, NameOf(a)),
                             MakeCause(Kind::InstanceAttribute, NameOf(b))}};
        if (rules_.hasExactAttributes) {
            CompareAttributes(ListAttributes(a, rules_), ListAttributes(b, rules_), holder);
        } else {
            CompareAttributes(ListEffective(a, rules_), ListEffective(b, rules_), holder);
        }
    }
    if (!a.GetCommentView().empty() || !b.GetCommentView().empty()) {
        CompareComments(a, b, {{"instance " + NameOf(a), "instance " + NameOf(b)}, {}});
    }
    if (rules_.hasExactAttributes) {
        CompareInstancePins(a, b);
    }
}

/// Attributes and comments of the pins of an instance. Hardly any pin has any.
void Comparison::CompareInstancePins(const Instance& a, const Instance& b) {
    const auto says = [](const Pin& pin) {
        return pin.HasAttrs() || !pin.GetCommentView().empty();
    };
    const auto compare = [&](const Pin& inA, const Pin& inB) {
        const Holder holder{
            {"pin " + NameOf(a) + "." + NameOf(inA), "pin " + NameOf(b) + "." + NameOf(inB)},
            {MakeCause(Kind::Connection, NameOf(a), NameOf(inA)),
             MakeCause(Kind::Connection, NameOf(b), NameOf(inB))}};
        if (rules_.attributes) {
            CompareAttributes(ListAttributes(inA, rules_), ListAttributes(inB, rules_), holder);
        }
        CompareComments(inA, inB, holder);
    };
    for (const Pin* pin : a.GetPinIterator()) {
        const Pin* const other = says(*pin) ? b.GetPin(pin->GetNameView()) : nullptr;
        if (other != nullptr) {
            compare(*pin, *other);
        }
    }
    for (const Pin* pin : b.GetPinIterator()) {
        const Pin* const other = says(*pin) ? a.GetPin(pin->GetNameView()) : nullptr;
        if (other != nullptr && !says(*other)) {
            compare(*other, *pin);
        }
    }
}

/// \param isTie set to whether both nets are constants.
bool Comparison::AreEqualNets(std::uint32_t netA, std::uint32_t netB, bool& isTie) const {
    const auto isConstant = [](const Graph& graph, std::uint32_t net) {
        return net != Open &&
               (net < Graph::FirstNet || (graph.GetTie(net) != Graph::Untied &&
                                          graph.GetSignalOfBit(graph.GetBit(net)).isGenerated));
    };
    isTie = isConstant(graphs_[A], netA) && isConstant(graphs_[B], netB);
    return matching_.AreMatched(netA, netB) &&
           (!isTie || graphs_[A].GetTie(netA) == graphs_[B].GetTie(netB));
}

void Comparison::CompareConnections(std::uint32_t rowA, std::uint32_t rowB) {
    const PairedComponent& component = components_.Get(Row(A, rowA).component);
    const std::uint32_t* const netsA = graphs_[A].GetPinNets().data() + Row(A, rowA).first;
    const std::uint32_t* const netsB = graphs_[B].GetPinNets().data() + Row(B, rowB).first;
    for (const PairedPin& pin : component.pins) {
        if (pin.pins[A] == nullptr || pin.pins[B] == nullptr) {
            continue;
        }
        bool areEqual = true;
        bool areTies = true;
        for (std::uint32_t i = pin.first; i < pin.first + pin.width; ++i) {
            // Most nets are equal and no constants.
            if (netsA[i] == Open || netsB[i] == Open || matching_.nets[A][netsA[i]] != netsB[i] ||
                graphs_[A].GetTie(netsA[i]) > Graph::TiedToDontCare) {
                bool isTie = false;
                if (!AreEqualNets(netsA[i], netsB[i], isTie)) {
                    areEqual = false;
                    areTies = areTies && isTie;
                }
            }
        }
        if (!areEqual) {
            const Instance& a = *Row(A, rowA).instance;
            const Instance& b = *Row(B, rowB).instance;
            AddConnection(areTies ? Change::Retied : Change::Rewired,
                          a.GetPin(pin.pins[A]->GetNameView()),
                          b.GetPin(pin.pins[B]->GetNameView()), a, b);
        }
    }
}

/// The nets of pins that have the same names, of instances of different components.
void Comparison::CompareConnectionsByName(std::uint32_t rowA, std::uint32_t rowB) {
    const Instance& a = *Row(A, rowA).instance;
    const Instance& b = *Row(B, rowB).instance;
    const auto netsOf = [&](Design design, std::uint32_t row, const Pin& pin) {
        const InstanceRow& instance = Row(design, row);
        const std::uint32_t at =
            components_.FindPin(instance.component, design, pin.GetNameView(), 0);
        std::vector<std::uint32_t> nets;
        if (at != None) {
            const PairedPin& paired = components_.Get(instance.component).pins[at];
            const auto first = graphs_[design].GetPinNets().begin() + instance.first + paired.first;
            nets.assign(first, first + paired.width);
        }
        return nets;
    };
    for (const Pin* pin : a.GetPinIterator()) {
        const Pin* const other = b.GetPin(pin->GetNameView());
        if (other == nullptr) {
            continue;
        }
        const std::vector<std::uint32_t> netsA = netsOf(A, rowA, *pin);
        const std::vector<std::uint32_t> netsB = netsOf(B, rowB, *other);
        const bool areEqual = std::equal(netsA.begin(), netsA.end(), netsB.begin(), netsB.end(),
                                         [this](std::uint32_t netA, std::uint32_t netB) {
                                             return matching_.AreMatched(netA, netB);
                                         });
        if (!areEqual) {
            AddConnection(Change::Rewired, pin, other, a, b);
        }
    }
}

void Comparison::AddConnection(Change change, const Pin* pinA, const Pin* pinB, const Instance& a,
                               const Instance& b) {
    if (!found_.Count(change)) {
        return;
    }
    const auto describe = [&](const Instance& instance, const Pin* pin, Side& side) {
        if (pin == nullptr) {
            return;
        }
        side.name = NameOf(instance) + "." + NameOf(*pin);
        side.cause = MakeCause(Kind::Connection, NameOf(instance), NameOf(*pin));
        const Signal* const signal = pin->GetSignal();
        const bool isGenerated =
            signal != nullptr && Orn_Hdl::HdlUtilities::IsGeneratedName(signal->GetName().CStr());
        if (signal == nullptr) {
            side.text = "open";
        } else if (isGenerated && !signal->GetConstantValue().GetValue().IsEmpty()) {
            side.text = "constant " + std::string(signal->GetConstantValue().GetValue().GetView());
        } else {
            side.text = NameOf(*signal);
        }
    };
    Difference difference;
    difference.change = change;
    difference.thing = Thing::Pin;
    describe(a, pinA, difference.a);
    describe(b, pinB, difference.b);
    found_.Keep(std::move(difference));
}

void Comparison::AddAlias(Change change, const AliasRow* a, const AliasRow* b) {
    if (!found_.Count(change)) {
        return;
    }
    const auto describe = [](const AliasRow* alias, Side& side) {
        if (alias != nullptr) {
            side.name = NameOf(*alias->target) + " = " + NameOf(*alias->source);
            side.cause = MakeCause(Kind::Alias, NameOf(*alias->target), NameOf(*alias->source));
        }
    };
    Difference difference;
    difference.change = change;
    difference.thing = Thing::Alias;
    describe(a, difference.a);
    describe(b, difference.b);
    found_.Keep(std::move(difference));
}

/// The bits of an alias follow each other.
void Comparison::CompareAliases() {
    for (const Design design : {A, B}) {
        const AliasRow* told = nullptr;
        const Graph& graph = graphs_[design];
        for (std::uint32_t row = graph.GetInstanceCount(); row < graph.GetInstances().size();
             ++row) {
            const AliasRow& alias = graph.GetAlias(row);
            const std::uint32_t other = matching_.instances[design][row];
            if (told != nullptr && told->target == alias.target && told->source == alias.source) {
                continue;
            }
            if (other == None) {
                told = &alias;
                AddAlias(design == A ? Change::Removed : Change::Added,
                         design == A ? &alias : nullptr, design == B ? &alias : nullptr);
                continue;
            }
            const std::uint32_t first = Row(design, row).first;
            const std::uint32_t otherFirst = Row(Other(design), other).first;
            const auto agrees = [&](std::uint32_t pin) {
                const std::uint32_t net = graph.GetPinNets()[first + pin];
                return matching_.nets[design][net] ==
                       graphs_[Other(design)].GetPinNets()[otherFirst + pin];
            };
            if (design == A && (!agrees(0) || !agrees(1))) {
                told = &alias;
                AddAlias(Change::Rewired, &alias, &graphs_[B].GetAlias(other));
            }
        }
    }
}

std::uint64_t HashNames(const Netlist& netlist, bool withPins) {
    std::uint64_t hash = 0;
    const auto add = [&hash](const Object* object) {
        hash = Mix(hash, object == nullptr ? 0 : HashName(object->GetNameView()));
    };
    for (const Component* component : netlist.GetComponentIterator()) {
        add(component);
    }
    for (const Signal* signal : netlist.GetSignalIterator()) {
        add(signal);
        for (const Signal* source : signal->GetSignalIterator()) {
            add(source);
        }
    }
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        add(instance);
        for (const Pin* pin : instance->GetPinIterator()) {
            if (withPins) {
                add(pin->GetSignal());
            }
        }
    }
    return hash;
}

Differences CompareInOrder(const Netlist& a, const Netlist& b, const Rules& rules,
                           std::size_t most) {
    Comparison comparison(a, b, rules, most);
    Differences byNames = comparison.Run(true);
    if (rules.names || byNames.GetTotal() == 0) {
        return byNames;
    }
    Differences byNets = comparison.Run(false);
    return byNets.GetTotal() < byNames.GetTotal() ? std::move(byNets) : std::move(byNames);
}

} // namespace

/// What cannot be told apart is matched in its order, so the order of the designs could show. They
/// are therefore compared in an order that depends on nothing but them.
Differences Compare(const Netlist& a, const Netlist& b, const Rules& rules, std::size_t most) {
    if (HashNames(a, !rules.names) <= HashNames(b, !rules.names)) {
        return CompareInOrder(a, b, rules, most);
    }
    Differences found = CompareInOrder(b, a, rules, most);
    found.Flip();
    return found;
}

} // namespace Tool::Diff
