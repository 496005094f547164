#include "reader/NameBasedUuid.h"

#include <boost/uuid/uuid_io.hpp>
#include <gtest/gtest.h>

#include <set>

using boost::uuids::to_string;
using debian::nameBasedUuid;

// The expected values were computed by another program's implementation of version 5.
TEST(NameBasedUuid, IsTheSameEverywhere)
{
    EXPECT_EQ(to_string(nameBasedUuid("package", "zlib1g", "1:1.2.13.dfsg-1", "amd64")),
              "196367ad-05cb-52b3-8b9c-9f4e8515b806");
    EXPECT_EQ(to_string(nameBasedUuid("", "", "", "")), "c8554c47-51ef-5092-b485-6f4c37bb3cf9");
}

TEST(NameBasedUuid, IsOfVersionFiveAndTheStandardVariant)
{
    auto const id = nameBasedUuid("package", "dpkg", "1.21.22", "amd64");

    EXPECT_EQ(id.version(), boost::uuids::uuid::version_name_based_sha1);
    EXPECT_EQ(id.variant(), boost::uuids::uuid::variant_rfc_4122);
}

TEST(NameBasedUuid, DiffersWhenAnyPartDiffers)
{
    std::set const ids = {
        nameBasedUuid("package", "a", "1", "all"),  nameBasedUuid("section", "a", "1", "all"),
        nameBasedUuid("package", "b", "1", "all"),  nameBasedUuid("package", "a", "2", "all"),
        nameBasedUuid("package", "a", "1", "i386"), nameBasedUuid("package", "a", "1.0", "all"),
    };

    EXPECT_EQ(ids.size(), 6u);
}

TEST(NameBasedUuid, DiffersWhenCharactersMoveFromOnePartToAnother)
{
    std::set const ids = {
        nameBasedUuid("ab", "", "", ""),   nameBasedUuid("a", "b", "", ""),
        nameBasedUuid("", "ab", "", ""),   nameBasedUuid("a", "", "b", ""),
        nameBasedUuid("", "", "", "ab"),   nameBasedUuid("1:a", "", "", ""),
        nameBasedUuid("a1:b", "", "", ""),
    };

    EXPECT_EQ(ids.size(), 7u);
}
