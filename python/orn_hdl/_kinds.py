"""How the extension numbers kinds of objects and classes of signals."""

MODULE, COMPONENT, INSTANCE, SIGNAL, BUS, COMPONENT_PIN, INSTANCE_PIN = range(7)

SCALAR_SIGNAL, BUS_SIGNAL, SLICE_SIGNAL, BIT_SIGNAL, COMPOUND_SIGNAL = range(50, 55)
