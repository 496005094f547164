/// \file
/// The list of the types that the entries of a primitive collection may have.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/Language.h"
#include "tarnkiln/meta/TransactionOrigin.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

/// Calls `X(T)` for each of them.
#define TARNKILN_FOR_EACH_PRIMITIVE_TYPE(X)                                                        \
    X(::tarn::kiln::ustring)                                                                       \
    X(::tarn::kiln::string)                                                                        \
    X(int)                                                                                         \
    X(signed char)                                                                                 \
    X(short)                                                                                       \
    X(long)                                                                                        \
    X(double)                                                                                      \
    X(bool)                                                                                        \
    X(unsigned int)                                                                                \
    X(unsigned char)                                                                               \
    X(unsigned short)                                                                              \
    X(unsigned long)                                                                               \
    X(::tarn::kiln::UUID)                                                                          \
    X(::boost::posix_time::ptime)                                                                  \
    X(::tarn::kiln::meta::ExtensionPrototype)                                                      \
    X(::tarn::kiln::meta::TransactionOrigin)                                                       \
    X(::tarn::kiln::meta::Language)
