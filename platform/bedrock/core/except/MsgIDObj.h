/// \file
/// The name of a message: an id within a catalogue.
#pragma once
#include "bedrock/core/except/Export.h"

#include <compare>
#include <string>

namespace bedrock::core::except {

/// Names one message of one catalogue, such as "NoSuchType" of "tarnkiln:messages".
///
/// A value: equal when both texts are equal, ordered by catalogue, then by id.
class BEDROCK_EXCEPT_EXPORT MsgIDObj
{
public:
    MsgIDObj(std::string id, std::string catalogue);

    std::string const& getID() const { return m_id; }
    std::string const& getCatalogue() const { return m_catalogue; }

    /// Catalogue, colon, id: "tarnkiln:messages:NoSuchType".
    std::string toString() const;

    friend bool operator==(MsgIDObj const&, MsgIDObj const&) = default;
    friend std::strong_ordering operator<=>(MsgIDObj const&, MsgIDObj const&) = default;

private:
    std::string m_catalogue;
    std::string m_id;
};
}  // namespace bedrock::core::except
