#include "tarnkiln/collections/ReflectiveEnumCollection.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln {
namespace {

/// `value`, if it is of the type that the entries have.
Value const& checked(Value const& value, AbstractPrimitiveCollection const& collection)
{
    if (value.getType() != collection.getCollectionType())
        reportException(tarnkiln::messages::CannotCastIncompatibleTypes(
            internal::qualifiedName(value.getType())));
    return value;
}
}  // namespace

/// Lets no literal of another enumeration through.
class ReflectiveEnumSequence::CheckedInterface final : public GenericPrimitiveSequenceInterface
{
public:
    CheckedInterface(ReflectiveEnumSequence const& sequence,
                     GenericPrimitiveSequenceInterface& generic)
        : m_sequence(sequence),
          m_generic(generic)
    {}

    // GenericPrimitiveSequenceInterface
    Value genericAt(unsigned long index) override { return m_generic.genericAt(index); }
    void genericInsert(Value const& value, unsigned long index) override
    {
        m_generic.genericInsert(checked(value, m_sequence), index);
    }
    void genericReplace(Value const& value, unsigned long index) override
    {
        m_generic.genericReplace(checked(value, m_sequence), index);
    }
    void genericRemoveAt(unsigned long index) override { m_generic.genericRemoveAt(index); }
    int genericIndexOf(Value const& value) const override
    {
        return m_generic.genericIndexOf(checked(value, m_sequence));
    }

private:
    ReflectiveEnumSequence const& m_sequence;
    GenericPrimitiveSequenceInterface& m_generic;
};

ReflectiveEnumSequence::ReflectiveEnumSequence(ModelElement::Impl* owner, bool unique,
                                               meta::Property const& property)
    : PrimitiveSequence(owner, unique, property),
      m_checked(
          std::make_unique<CheckedInterface>(*this, static_cast<GenericPrimitiveSequenceInterface&>(
                                                        *PrimitiveSequence::getGenericInterface())))
{}

ReflectiveEnumSequence::~ReflectiveEnumSequence() = default;

void ReflectiveEnumSequence::genericAdd(Value const& value)
{
    PrimitiveSequence::genericAdd(checked(value, *this));
}

void ReflectiveEnumSequence::genericRemove(Value const& value)
{
    PrimitiveSequence::genericRemove(checked(value, *this));
}

GenericPrimitiveInterface* ReflectiveEnumSequence::getGenericInterface() const
{
    return m_checked.get();
}

ReflectiveEnumSet::ReflectiveEnumSet(ModelElement::Impl* owner, meta::Property const& property)
    : PrimitiveSet(owner, property)
{}

ReflectiveEnumSet::~ReflectiveEnumSet() = default;

void ReflectiveEnumSet::genericAdd(Value const& value)
{
    PrimitiveSet::genericAdd(checked(value, *this));
}

void ReflectiveEnumSet::genericRemove(Value const& value)
{
    PrimitiveSet::genericRemove(checked(value, *this));
}

AbstractOwnedCollection* makeReflectiveEnumCollection(ModelElement const& owner,
                                                      meta::Property const& property)
{
    if (property->isOrdered())
        return new ReflectiveEnumSequence(owner.getImpl(), property->isUnique(), property);
    return new ReflectiveEnumSet(owner.getImpl(), property);
}
}  // namespace tarn::kiln
