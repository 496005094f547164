/// \file
/// One question to an index, as the user asks it.
#pragma once
#include <string>

namespace debian {

struct Question
{
    enum class Kind
    {
        Unmet,             ///< Which strict dependencies are not satisfied?
        UnmetRecommended,  ///< Which recommendations?
        SameMaintainer,    ///< Which packages depend on one of the same maintainer?
        Largest,           ///< Which are the largest packages that match a pattern?
        Reverse,           ///< Which dependencies name a package?
        Tag                ///< Which packages have a tag that those get that match a pattern?
    };

    Kind kind;
    std::string argument;  ///< The pattern, or the name; empty where there is none.

    bool operator==(Question const&) const = default;
};

}  // namespace debian
