// How values are shown to people.
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/streamText.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/PropertySerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/meta/internal/PayloadAccess.h"

#include <vector>

namespace tarn::kiln {
namespace {

using internal::streamContents;
using support::PayloadAccess;

// Each of these says whether the value is one for it.

template <class T> bool streamHandle(std::ostream& out, Value const& value)
{
    T const* const handle = PayloadAccess::get<T>(value);
    if (handle)
        out << *handle;
    return handle;
}

bool streamText(std::ostream& out, Value const& value)
{
    auto const* const wide = PayloadAccess::get<ustring>(value);
    auto const* const narrow = PayloadAccess::get<string>(value);
    if (wide)
        internal::streamQuoted(out, *wide);
    else if (narrow)
        out << std::quoted(*narrow);
    return wide || narrow;
}

bool streamFields(std::ostream& out, Value const& value)
{
    meta::DataType const type = meta::DataType::cast(value.getType());
    if (!type)
        return false;
    auto const* const reflective = PayloadAccess::get<ReflectiveDataType>(value);
    if (!reflective && !meta::PropertySerializerRegistry::getInstance().getDatatypeSerializer(type))
        return false;
    ReflectiveDataType const object =
        reflective ? *reflective : PayloadAccess::asSingle(value).toReflectiveDataType();
    std::vector<meta::Property> fields;
    for (auto const& [name, property] : type->getOwnedAttributes())
    {
        if (property && property->getType())
            fields.push_back(property);
    }
    internal::streamEntries(out, fields, [&](meta::Property const& field) {
        out << toUtf8(field->getName()) << ": ";
        streamContents(out, object.getPropertyValue(field));
    });
    return true;
}

/// By the ordinary text form. A number that is no literal's has none.
bool streamTextForm(std::ostream& out, Value const& value)
{
    auto const* const serializer =
        value.getType() ? meta::PropertySerializerRegistry::getInstance().getPropertySerializer(
                              value.getType(), "")
                        : nullptr;
    if (!serializer)
        return false;
    string const text = toUtf8(serializer->serializeValue(PayloadAccess::asSingle(value)));
    auto const* const literal = PayloadAccess::get<unsigned long>(value);
    if (text.empty() && literal)
        out << static_cast<long>(*literal);
    else
        out << text;
    return true;
}

void streamOne(std::ostream& out, Value const& value)
{
    if (!streamHandle<ModelElement>(out, value) && !streamHandle<Model>(out, value) &&
        !streamText(out, value) && !streamFields(out, value) && !streamTextForm(out, value))
        out << "something without a text form";
}

/// Of a container that the value owns.
std::vector<Value> entriesOf(Value const& value)
{
    try
    {
        return value.extractEntryValues();
    }
    catch (tarnkiln::messages::CannotCastIncompatibleTypes const&)
    {
        // An assigned value can not tell its entries.
        return {value};
    }
}

void streamContainer(std::ostream& out, Value const& value)
{
    internal::streamEntries(out, entriesOf(value), [&](Value const& entry) {
        if (entry.getFlags() > ValueFlags::Single)
            out << "something that can't be taken out";
        else
            streamContents(out, entry);
    });
}

}  // namespace

void internal::streamContents(std::ostream& out, Value const& value)
{
    if (value.isAbsent())
        out << "absent";
    else if (AbstractOwnedCollection const* const managed = PayloadAccess::managed(value))
        out << *managed;
    else if (value.getFlags() > ValueFlags::Single)
        streamContainer(out, value);
    else
        streamOne(out, value);
}

std::ostream& operator<<(std::ostream& out, ValueFlags flags)
{
    switch (flags)
    {
    case ValueFlags::OptionalSingle:
        return out << "OptionalSingle";
    case ValueFlags::Single:
        return out << "Single";
    case ValueFlags::Sequence:
        return out << "Sequence";
    case ValueFlags::Set:
        return out << "Set";
    case ValueFlags::Map:
        return out << "Map";
    case ValueFlags::Multimap:
        return out << "Multimap";
    }
    return out << static_cast<unsigned int>(flags);
}

std::ostream& operator<<(std::ostream& out, Value const& value)
{
    if (value.getFlags() != ValueFlags::Single)
        out << value.getFlags() << " of ";
    meta::Type const& type = value.getType();
    out << (type.getImpl() ? toUtf8(type->getName()) : "no type")
        << (value.isAbsent() ? ", " : " ");
    streamContents(out, value);
    return out;
}
}  // namespace tarn::kiln
