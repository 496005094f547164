/// \file
/// How a property may be used through reflection.
#pragma once

namespace tarn::kiln::internal {

/// A right of access, compared by address; see `ModelElement::Impl::PUBLIC_ACCESS` and its peers.
class ReflectionPrivateTag
{
public:
    constexpr ReflectionPrivateTag() = default;
    ReflectionPrivateTag(ReflectionPrivateTag const&) = delete;
    ReflectionPrivateTag& operator=(ReflectionPrivateTag const&) = delete;

    bool operator==(ReflectionPrivateTag const& other) const { return this == &other; }
};
}  // namespace tarn::kiln::internal
