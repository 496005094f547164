#include "tarnkiln/kernel/Text.h"

#include <boost/uuid/uuid_hash.hpp>

#include <unordered_set>

namespace tarn::kiln {
namespace {

TEST(Text, OfModelsAndUtf8AreMadeOfOneAnother)
{
    EXPECT_EQ(u"Z\u00fcrich \U0001F600", toUstring("Z\xC3\xBCrich \xF0\x9F\x98\x80"));
    EXPECT_EQ("Z\xC3\xBCrich \xF0\x9F\x98\x80", toUtf8(u"Z\u00fcrich \U0001F600"));
}

TEST(Text, ThatIsNoUtf8ComesBackAsItWas)
{
    string const bytes("a\xFF\x80\0b", 5);

    EXPECT_EQ(bytes, toUtf8(toUstring(bytes)));
}

TEST(Uuids, CanBeKeptInHashedContainers)
{
    UUID const one{{1}}, two{{2}};
    std::unordered_set<UUID> const set{one, two, one};

    EXPECT_EQ(2u, set.size());
}
}  // namespace
}  // namespace tarn::kiln
