#include "HdlModel/Signals/BusParts.h"

#include "Containers/PlaceOf.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"

#include <memory>

namespace Orn_Hdl {

void BusParts::Add(BusPart& part) {
    if (part.parts_ == this) {
        return;
    }
    signals_.Add(&part);
    if (part.parts_ != nullptr) {
        part.parts_->Remove(part);
    }
    part.parts_ = this;
}

void BusParts::AddAny(Signal& signal) {
    if (BusPart* const part = As<BusPart>(&signal)) {
        Add(*part);
    } else if (!signals_.Contains(&signal)) {
        References::Add(*bus_, signals_, signal);
        ++others_;
    }
}

/// Drops the links of a signal that has left the list.
void BusParts::Unlink(Signal& signal) noexcept {
    if (BusPart* const part = As<BusPart>(&signal)) {
        part->parts_ = nullptr;
    } else {
        --others_;
        References::Drop(signal, *bus_);
    }
}

void BusParts::Remove(BusPart& part) noexcept {
    signals_.RemoveAt(PlaceOf<Signal>(signals_, &part));
    part.parts_ = nullptr;
}

void BusParts::RemoveAny(Signal* signal) noexcept {
    const int place = PlaceOf<Signal>(signals_, signal);
    if (place >= 0) {
        signals_.RemoveAt(place);
        Unlink(*signal);
    }
}

void BusParts::RemoveAll() noexcept {
    while (!signals_.IsEmpty()) {
        Signal* const last = signals_.GetTail();
        signals_.RemoveTail();
        Unlink(*last);
    }
}

void BusParts::Forget(Signal& other) noexcept {
    others_ -= signals_.Remove(&other) ? 1 : 0;
}

void BusParts::TakeOver(Bus& bus, Bus& from) {
    // The list of `from` changes hands as it is, however long it is; what `bus` has goes before it.
    // What can fail comes first.
    auto own = std::make_unique<BusParts>(bus);
    PtrArray<Signal*>& signals = from.parts_->signals_;
    int inserted = 0;
    try {
        for (; inserted < bus.parts_->signals_.GetSize(); ++inserted) {
            signals.InsertAt(inserted, bus.parts_->signals_.GetAt(inserted));
        }
    } catch (...) {
        for (; inserted > 0; --inserted) {
            signals.RemoveAt(0);
        }
        throw;
    }
    own.swap(bus.parts_);
    bus.parts_.swap(from.parts_);
    bus.parts_->bus_ = &bus;
    from.parts_->bus_ = &from;
    for (Signal* signal : Iterator<Signal*>(&own->signals_)) {
        if (BusPart* const part = As<BusPart>(signal)) {
            part->parts_ = bus.parts_.get();
        }
    }
    for (int i = inserted; bus.parts_->others_ > 0 && i < signals.GetSize(); ++i) {
        if (As<BusPart>(signals.GetAt(i)) == nullptr) {
            References::Note(*signals.GetAt(i), bus);
            References::Drop(*signals.GetAt(i), from);
        }
    }
    bus.parts_->others_ += own->others_;
}

} // namespace Orn_Hdl
