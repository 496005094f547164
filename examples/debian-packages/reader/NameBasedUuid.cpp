#include "reader/NameBasedUuid.h"

#include <boost/uuid/name_generator_sha1.hpp>

#include <string>

namespace debian {
namespace {

// 0ae40134-f9a1-42e7-b19f-69d8ced7c324. Another value gives all packages new identities.
constexpr boost::uuids::uuid NAMESPACE = {{0x0a, 0xe4, 0x01, 0x34, 0xf9, 0xa1, 0x42, 0xe7, 0xb1,
                                           0x9f, 0x69, 0xd8, 0xce, 0xd7, 0xc3, 0x24}};

}  // namespace

boost::uuids::uuid nameBasedUuid(std::string_view kind, std::string_view name,
                                 std::string_view version, std::string_view architecture)
{
    std::string encoded;
    for (std::string_view const part : {kind, name, version, architecture})
        encoded.append(std::to_string(part.size())).append(1, ':').append(part);
    return boost::uuids::name_generator_sha1(NAMESPACE)(encoded);
}

}  // namespace debian
