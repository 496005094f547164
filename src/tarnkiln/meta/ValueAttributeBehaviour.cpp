/// \file
/// The types of the values of attributes.
#include "tarnkiln/meta/AttributeMapAttributeImpl.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/BooleanAttributeImpl.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DateTimeAttributeImpl.h"
#include "tarnkiln/meta/IntegerAttributeImpl.h"
#include "tarnkiln/meta/RealAttributeImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/StringAttributeImpl.h"
#include "tarnkiln/meta/UUIDAttributeImpl.h"

namespace tarn::kiln::meta {

Type BooleanAttribute::Impl::getType() const
{
    return standardTypeOf<bool>();
}

Type DateTimeAttribute::Impl::getType() const
{
    return standardTypeOf<boost::posix_time::ptime>();
}

Type IntegerAttribute::Impl::getType() const
{
    return standardTypeOf<int>();
}

Type RealAttribute::Impl::getType() const
{
    return standardTypeOf<double>();
}

Type StringAttribute::Impl::getType() const
{
    return standardTypeOf<ustring>();
}

Type UUIDAttribute::Impl::getType() const
{
    return standardTypeOf<UUID>();
}

Type AttributeMapAttribute::Impl::getType() const
{
    return AttributeMap::metaClass();
}
}  // namespace tarn::kiln::meta
