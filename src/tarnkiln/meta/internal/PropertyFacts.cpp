#include "tarnkiln/meta/internal/PropertyFacts.h"

#include "tarnkiln/meta/TypeImpl.h"

namespace tarn::kiln::internal {
namespace {

template <class Impl> Impl const* live(Impl const* element)
{
    return element && element->isLive() ? element : nullptr;
}
}  // namespace

PropertyFacts::PropertyFacts(meta::Property::Impl const& property)
    : property(&property),
      type(live(property.getTypeImpl())),
      opposite(live(property.getOppositeImpl())),
      qualifier(live(property.getQualifiedByImpl())),
      index(property.getPropertyIndex()),
      isSingle(property.getUpper() == 1),
      isRequired(property.getLower() == 1),
      isDerived(property.isDerived()),
      isOrdered(property.isOrdered()),
      isUnique(property.isUnique()),
      isQualificationUnique(property.isQualificationUnique()),
      isContainer(opposite && opposite->isComposite()),
      hasDefault(property.getDefaultValue().has_value())
{
    if (opposite)
        oppositeQualifier = live(opposite->getQualifiedByImpl());
    if (qualifier)
        qualifierType = live(qualifier->getTypeImpl());
}
}  // namespace tarn::kiln::internal
