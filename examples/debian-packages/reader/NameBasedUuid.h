/// \file
/// Identifiers of packages that every run of the program computes anew.
#pragma once
#include <boost/uuid/uuid.hpp>

#include <string_view>

namespace debian {

/// The UUID of something that belongs to a package index: version 5 of RFC 4122, in a namespace of
/// this example's own.
///
/// The same four texts always give the same UUID, on every machine; different ones give different
/// UUIDs, as far as SHA-1 can promise it. Each text is hashed with its length before it, so that
/// moving a character from one text to the next gives another UUID. Texts are taken as they are: no
/// case is folded, and versions that compare as equal but are written differently are different.
///
/// \param kind  what is named, such as "package"; keeps things of the same name apart.
boost::uuids::uuid nameBasedUuid(std::string_view kind, std::string_view name,
                                 std::string_view version, std::string_view architecture);

}  // namespace debian
