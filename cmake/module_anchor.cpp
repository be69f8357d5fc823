// The module's code lives in the subsystem libraries, linked whole; this unit
// only gives the shared library target a source of its own.
