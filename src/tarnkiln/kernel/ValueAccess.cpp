/// \file
/// The plain types that a `Value` can hold in any program.
#include "tarnkiln/support/ValueAccess.h"

#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/TransactionOrigin.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

namespace tarn::kiln::support {

/// A number may also be that of a literal.
template <> bool suits<long>(meta::Type const& type)
{
    return isStandardTypeOf<long>(type) || internal::isEnumType(type);
}

template <> bool suits<Model>(meta::Type const& type)
{
    return isStandardTypeOf<Model>(type) || (type.getElementImpl() && type == Model::metaClass());
}

template <> bool suits<meta::Operation>(meta::Type const& type)
{
    auto const* const own = internal::classImpl(type);
    return own && own->isLive() && own->isA(meta::Operation::metaClass());
}

template <> bool isKeptAsLiteral<long>(meta::Type const& type)
{
    return internal::isEnumType(type);
}

#define TARNKILN_DEFINE(T)                                                                         \
    template struct ValueAccess<T>;                                                                \
    template struct ValueAccess<boost::optional<T>>;                                               \
    template struct ValueAccess<std::vector<T>>;                                                   \
    template struct ValueAccess<std::set<T>>;
TARNKILN_FOR_EACH_PAYLOAD(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
template struct TARNKILN_EXPORT ValueAccess<std::vector<meta::Operation>>;
template struct TARNKILN_EXPORT ValueAccess<std::set<meta::Operation>>;
}  // namespace tarn::kiln::support
