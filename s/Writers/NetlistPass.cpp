#include "Writers/NetlistPass.h"

#include "HdlModel/Netlist/FeedBack.h"
#include "HdlModel/Netlist/NetlistSorting.h"
#include "Port/OrderedWork.h"

#include <algorithm>

namespace Orn_Hdl::Writers {

InstanceStarts::InstanceStarts(const Netlist& netlist) : distance_(GetRangeSizes().items) {
    const Iterator<Instance*> instances = netlist.GetInstanceIterator();
    for (Cursor place = instances.begin(); place != instances.end(); ++place) {
        if (count_ == places_.size() * distance_) {
            places_.push_back(place);
        }
        ++count_;
    }
}

InstanceStarts::Cursor InstanceStarts::Find(std::size_t instance) const noexcept {
    Cursor place = places_[instance / distance_];
    for (std::size_t i = instance % distance_; i > 0; --i) {
        ++place;
    }
    return place;
}

void NetlistPass::Prepare() {
    // As long as the netlist is not sorted, its signals follow one another in memory.
    const bool mayNeedDummies = FeedBack::MayNeedDummies(netlist_);
    Sort();
    if (mayNeedDummies) {
        netlist_.CreateVhdlDummySignals();
    }
    passesInit_ = PassesInit(language_, netlist_);
}

void NetlistPass::Sort() {
    constexpr std::size_t Parts = NetlistSorting::Parts;
    const unsigned workers = options_.threads == 1 || !NetlistSorting::IsLong(netlist_)
                                 ? 0
                                 : Port::OrderedWork::GetWorkersFor(options_.threads);
    Port::OrderedWork work({std::min(workers, 1U), Parts}, [this](std::size_t part) {
        if (part < Parts) {
            NetlistSorting::SortPart(netlist_, part);
        }
        return part < Parts;
    });
    while (work.Next()) {
    }
}

void NetlistPass::WriteOpening() {
    if (options_.writeHeader) {
        HdlUtilities::WriteHeader(netlist_.GetName(), language_, options_, out_);
    }
    WriteComment(out_, language_, netlist_);
}

Attribute* NetlistPass::FindPassedInit(const GenericAttrs& attributes) const {
    return passesInit_ ? attributes.FindInit() : nullptr;
}

} // namespace Orn_Hdl::Writers
