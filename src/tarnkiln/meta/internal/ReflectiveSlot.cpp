#include "tarnkiln/meta/internal/ReflectiveSlot.h"

#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/PackedPayload.h"
#include "tarnkiln/meta/internal/PayloadAccess.h"
#include "tarnkiln/support/ValueAccess.h"

#include <bit>
#include <exception>

namespace tarn::kiln::internal {

using meta::MetaRegistry;

namespace {

/// What a new element has as its value of `property`, a single plain one.
Value initialValueOf(meta::Property const& property)
{
    boost::optional<Value> const declared = property->defaultValue();
    return declared ? *declared : Value::createEmptyValue(property);
}

/// What `use` answers for the payload of a value that can be packed.
template <class T, class Use> auto usePayload(Value const& value, Use const& use)
{
    if (T const* const payload = support::PayloadAccess::get<T>(value))
        return use(*payload);
    if (value.getFlags() == ValueFlags::Single)
        return use(value.getValue<T>());
    return use(*value.getValue<boost::optional<T>>());
}

boost::optional<Value> emptyValueOf(meta::Property const& property)
{
    try
    {
        Value const empty = Value::createEmptyValue(property);
        return boost::make_optional(empty.isAbsent(), empty);
    }
    catch (std::exception const&)
    {
        return boost::none;
    }
}
}  // namespace

ReflectiveSlot::ReflectiveSlot(meta::Property const& property)
    : m_property(property),
      m_type(property->getType()),
      m_index(static_cast<unsigned long>(property->getPropertyIndex()))
{
    if (!m_type)
        reportException(tarnkiln::messages::CannotUsePropertyWithoutType(property->getName()));

    bool const isSingle = property->getUpper() == 1;
    if (classImpl(m_type))
    {
        meta::Property const opposite = property->getOpposite();
        if (opposite)
            m_oppositeQualifier = opposite->getQualifiedBy();
        if (opposite && opposite->isComposite())
            m_kind = SlotKind::Container;
        else if (isSingle)
            m_kind = SlotKind::Reference;
        else
            m_kind = SlotKind::References;
        if (m_kind == SlotKind::References)
            m_recipe.emplace(property);
        return;
    }
    m_kind = isSingle ? plainKindOf(m_type) : SlotKind::Values;
    if (m_kind == SlotKind::Values)
        makeCollection(nullptr);  // fails now if it ever would
    if (!isPlain(m_kind))
        return;
    findWordPayload();
    Value const initial = initialValueOf(property);
    if (property->getLower() != 1)
        m_empty = emptyValueOf(property);
    if (!isInitialShared())
        return;
    m_initial = initial;
    ReflectiveCell const cell = keep(initial);
    if (owns(cell))
        free(cell);
    else
        m_initialCell = cell;
}

void ReflectiveSlot::setPlaces(std::size_t number, std::size_t wordAt, std::size_t stateAt)
{
    m_number = static_cast<std::uint16_t>(number);
    m_wordAt = static_cast<std::uint32_t>(wordAt);
    m_stateAt = static_cast<std::uint32_t>(stateAt);
}

/// The number of a literal is none of these: what values carry it as depends on its type.
void ReflectiveSlot::findWordPayload()
{
    if (m_kind >= SlotKind::Enumeration)
        return;
    withPayloadType(m_kind, [this]<class T>() {
        if constexpr (Packed<T>::IN_PLACE)
        {
            using Payload = support::PayloadOf<T>;
            static_assert(Payload::FUNCTIONS.isTrivial);
            m_wordPayload = &Payload::FUNCTIONS;
            // Payloads lie in the first bytes, which are the low ones.
            static_assert(std::endian::native == std::endian::little);
            m_wordMask = ~std::uint64_t{0} >> (8 * (sizeof m_wordMask - sizeof(T)));
        }
    });
}

/// Whether nothing but the property decides what elements start with: the value of a text may
/// depend on what reads it, that of an enumeration on its literals.
bool ReflectiveSlot::isInitialShared() const
{
    if (m_property->getDefaultValue())
        return false;
    return m_kind < SlotKind::Enumeration ||
           (m_kind == SlotKind::Enumeration && m_property->getLower() != 1);
}

ReflectiveCell ReflectiveSlot::keepInitial() const
{
    return keepOwn(m_initial ? *m_initial : initialValueOf(m_property));
}

// ---------------------------------------------------------------------------- plain values

bool ReflectiveSlot::isEmpty(Value const& value) const
{
    return value.isAbsent() && m_empty && value.getFlags() == m_empty->getFlags() &&
           value.getType() == m_empty->getType() &&
           value.isReflective() == m_empty->isReflective() &&
           value.isManaged() == m_empty->isManaged();
}

/// Whether a word can tell all there is to the value.
bool ReflectiveSlot::isPackable(Value const& value) const
{
    ValueFlags const flags = value.getFlags();
    bool const isShaped = flags == ValueFlags::Single ||
                          (flags == ValueFlags::OptionalSingle && m_kind != SlotKind::Enumeration);
    return m_kind < SlotKind::Other && isShaped && !value.isAbsent() && value.getType() == m_type &&
           !value.isReflective() && value.isManaged() && withPayloadType(m_kind, [&]<class T>() {
               T const* const payload = support::PayloadAccess::get<T>(value);
               return !payload || Packed<T>::fits(*payload);
           });
}

bool ReflectiveSlot::isSameWord(ReflectiveCell left, ReflectiveCell right) const
{
    if (left.state != right.state)
        return false;
    if (m_kind == SlotKind::Real)  // zero has two forms, and what is no number equals nothing
        return Packed<double>::unpack(left.word) == Packed<double>::unpack(right.word);
    return left.word == right.word;
}

Value ReflectiveSlot::read(ReflectiveCell cell) const
{
    if (isWord(cell))
        return readWord(cell);
    if (cell.state == CellState::Empty)
        return *m_empty;
    if (cell.state == CellState::Boxed)
        return *cell.pointer<Value>();
    if (m_kind == SlotKind::Enumeration)
        return cell.state == CellState::Single
                   ? Value(m_type, Packed<long>::unpack(cell.word))
                   : Value(m_type, boost::make_optional(Packed<long>::unpack(cell.word)));
    return withPayloadType(m_kind, [&]<class T>() {
        // The kind was chosen by the type: there is nothing to check.
        using support::ValueAccess;
        T const payload = Packed<T>::unpack(cell.word);
        return cell.state == CellState::Single
                   ? ValueAccess<T>::make(m_type, payload)
                   : ValueAccess<boost::optional<T>>::make(m_type, boost::optional<T>(payload));
    });
}

ReflectiveCell ReflectiveSlot::keep(Value const& value) const
{
    ReflectiveCell cell;
    if (isEmpty(value))
        return cell;
    if (!isPackable(value))
    {
        cell.point(new Value(value));
        cell.state = CellState::Boxed;
        return cell;
    }
    bool const isSingle = value.getFlags() == ValueFlags::Single;
    cell.word =
        withPayloadType(m_kind, [&]<class T>() { return usePayload<T>(value, Packed<T>::pack); });
    cell.state = isSingle ? CellState::Single : CellState::Optional;
    return cell;
}

ReflectiveCell ReflectiveSlot::keepOwn(Value const& value) const
{
    MetaRegistry& registry = MetaRegistry::getInstance();
    if (!registry.hasOwnershipConverters())
        return keep(value);
    return keep(registry.convertValueForOwnership(value));
}

/// Whether there is something to be freed behind a cell of a plain value.
bool ReflectiveSlot::owns(ReflectiveCell cell) const
{
    if (cell.state == CellState::Empty || cell.state == CellState::Boxed)
        return cell.state == CellState::Boxed;
    return withPayloadType(m_kind,
                           [&]<class T>() { return !Packed<T>::IN_PLACE && cell.word != 0; });
}

void ReflectiveSlot::free(ReflectiveCell cell) const noexcept
{
    if (cell.state == CellState::Boxed)
        delete cell.pointer<Value>();
    else if (cell.state != CellState::Empty && cell.word != 0)
        withPayloadType(m_kind, [&]<class T>() { Packed<T>::free(cell.word); });
}

Value ReflectiveSlot::asRequired(Value const& value) const
{
    if (value.getFlags() != ValueFlags::OptionalSingle || value.isAbsent())
        return value;
    if (m_kind == SlotKind::Enumeration)
        return Value(m_type, *value.getEnumNumber());
    if (!isPackable(value))
        return value;
    return withPayloadType(
        m_kind, [&]<class T>() { return Value(m_type, *value.getValue<boost::optional<T>>()); });
}

bool ReflectiveSlot::holds(ReflectiveCell cell, Value const& value) const
{
    if (!cell.isPacked() || !isPackable(value))
        return read(cell) == value;
    bool const isSingle = value.getFlags() == ValueFlags::Single;
    return isSingle == (cell.state == CellState::Single) && withPayloadType(m_kind, [&]<class T>() {
               return usePayload<T>(
                   value, [&](T const& payload) { return Packed<T>::equals(cell.word, payload); });
           });
}

// ---------------------------------------------------------------------------- all cells

void ReflectiveSlot::release(ReflectiveCell cell) const noexcept
{
    if (m_kind == SlotKind::Reference)
    {
        if (auto* const target = cell.pointer<ModelElement::Impl>())
            target->release();
        return;
    }
    if (isCollection(m_kind))
    {
        delete cell.pointer<AbstractOwnedCollection>();
        return;
    }
    if (cell.state == CellState::Empty)
        return;
    MetaRegistry& registry = MetaRegistry::getInstance();
    if (registry.hasOwnershipConverters())
        registry.releaseOwnedValue(read(cell));
    free(cell);
}

ReflectiveCell ReflectiveSlot::copy(ReflectiveCell cell) const
{
    ReflectiveCell result = cell;
    if (m_kind == SlotKind::Reference)
    {
        if (auto* const target = cell.pointer<ModelElement::Impl>())
            target->addRef();
    }
    else if (isCollection(m_kind))
    {
        std::unique_ptr<AbstractOwnedCollection> snapshot;
        if (auto* const present = cell.pointer<AbstractOwnedCollection>())
        {
            snapshot = makeCollection(nullptr);
            snapshot->copyContents(*present);
        }
        result.point(snapshot.release());
    }
    else if (isPlain(m_kind))
    {
        result = copyPlain(cell);
    }
    return result;
}

ReflectiveCell ReflectiveSlot::copyPlain(ReflectiveCell cell) const
{
    MetaRegistry& registry = MetaRegistry::getInstance();
    if (cell.state == CellState::Boxed || registry.hasOwnershipConverters())
        return keepOwn(read(cell));
    ReflectiveCell result = cell;
    if (cell.state != CellState::Empty)
        result.word = withPayloadType(m_kind, [&]<class T>() {
            return Packed<T>::IN_PLACE ? cell.word : Packed<T>::pack(Packed<T>::unpack(cell.word));
        });
    return result;
}

std::unique_ptr<AbstractOwnedCollection>
ReflectiveSlot::makeCollection(ModelElement::Impl* owner) const
{
    if (m_recipe)
        return m_recipe->make(owner);
    if (m_kind == SlotKind::Annotations)
        return std::make_unique<StringToStringMap>(owner, m_property);
    return std::unique_ptr<AbstractOwnedCollection>(
        MetaRegistry::getInstance().instantiateDynamicCollection(ModelElement(owner), m_property));
}
}  // namespace tarn::kiln::internal
