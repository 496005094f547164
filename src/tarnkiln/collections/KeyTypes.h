/// \file
/// The list of the types that a key of a keyed collection may have.
#pragma once
#include "tarnkiln/kernel/Types.h"

/// Calls `X(K)` for each key type; the data types of run-time metamodels come on top.
#define TARNKILN_FOR_EACH_KEY_TYPE(X)                                                              \
    X(int)                                                                                         \
    X(signed char)                                                                                 \
    X(short)                                                                                       \
    X(long)                                                                                        \
    X(unsigned int)                                                                                \
    X(unsigned char)                                                                               \
    X(unsigned short)                                                                              \
    X(unsigned long)                                                                               \
    X(double)                                                                                      \
    X(::tarn::kiln::ustring)                                                                       \
    X(::tarn::kiln::string)                                                                        \
    X(::tarn::kiln::UUID)
