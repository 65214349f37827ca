// What the objects take of which a design holds millions, to the byte. A larger one must be meant.
#include "Orn_Hdl/Orn_Hdl.h"

// With another standard library or another word size these are other numbers.
#if defined(__GLIBCXX__) && defined(__x86_64__) && defined(__LP64__)

namespace {

using namespace Orn_Hdl;

static_assert(sizeof(Object) == 24);
static_assert(sizeof(AttributeHolder) == 16);

static_assert(sizeof(PinList) == 32);
static_assert(sizeof(Instance) == 80);
static_assert(sizeof(Component) == 80);
static_assert(sizeof(Pin) == 48);
static_assert(sizeof(ScalarPin) == 48);
static_assert(sizeof(BusPin) == 48);
static_assert(sizeof(BusIndexPin) == 48);

static_assert(sizeof(Signal) == 96);
static_assert(sizeof(ScalarSignal) == 96);
static_assert(sizeof(BusIndex) == 104);
static_assert(sizeof(BusSlice) == 104);
static_assert(sizeof(Bus) == 104);
static_assert(sizeof(CompoundBus) == 120);

static_assert(sizeof(Attribute) == 32);
static_assert(sizeof(AttributeString) == 64);
static_assert(sizeof(AttributeBitVector) == 80);
static_assert(sizeof(BitVectorValue) == 48);

static_assert(sizeof(Command) == 16);

} // namespace

#endif
