/// \file
/// The marks of what the shared library lets out.
#pragma once

/// On every class and free function that a client may name: the library is built with hidden
/// visibility, so what lacks the mark can't be linked against from outside.
#define TARNKILN_EXPORT __attribute__((visibility("default")))

/// On internal classes that tests reach into. They leave the library only in builds that ask for
/// it (`TARNKILN_EXPORT_INTERNALS`), never in what is shipped.
#ifdef TARNKILN_EXPORT_INTERNALS
#    define TARNKILN_TESTED TARNKILN_EXPORT
#else
#    define TARNKILN_TESTED
#endif
