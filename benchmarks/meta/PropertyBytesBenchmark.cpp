// How many bytes a property adds to an element, by its kind, empty and with one value.
#include "benchmarks/support/LiveBytes.h"
#include "kinds/Member.h"
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Text.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <benchmark/benchmark.h>

#include <boost/date_time/posix_time/posix_time.hpp>

#include <functional>
#include <string>
#include <vector>

namespace benchkit {
namespace {

using namespace tarn::kiln;
using meta::StandardTypes;

constexpr std::int64_t COUNT = 10'000;
constexpr std::size_t PROPERTIES = 8;  // of each class, all of one kind

using Make = std::function<ModelElement(Model const&, meta::Class const&)>;

ModelElement makeGenerated(Model const& model, meta::Class const& metaClass)
{
    return metaClass->instantiate(model, UUID());
}
ModelElement makeReflective(Model const& model, meta::Class const& metaClass)
{
    return ModelElement::createReflective(model, metaClass);
}

/// Ten characters, a number that is not the default, a moment.
Value someValue(meta::Type const& type)
{
    if (type == StandardTypes::stringMeta)
        return Value(type, ustring(u"characters"));
    if (type == StandardTypes::integerMeta)
        return Value(type, 7);
    if (type == StandardTypes::realMeta)
        return Value(type, 7.5);
    if (type == StandardTypes::booleanMeta)
        return Value(type, true);
    if (type == StandardTypes::uuidMeta)
        return Value(type, ElementImpl::generateNewUuid());
    if (type == StandardTypes::dateTimeMeta)
        return Value(type, boost::posix_time::from_time_t(1));
    meta::Enum const enumeration = meta::Enum::cast(type);
    return Value::createEnumValue(enumeration->findLiteralByValue(1));
}

/// Gives `property` one value; `member` if it refers to elements.
void fill(ModelElement const& element, meta::Property const& property, ModelElement const& member)
{
    auto const& access = ModelElement::Impl::PUBLIC_ACCESS;
    bool const refers = static_cast<bool>(meta::Class::cast(property->getType()));
    if (property->getUpper() == 1)
    {
        element->setPropertyValue(
            property, refers ? Value(property->getType(), member) : someValue(property->getType()),
            access);
        return;
    }
    Value const collection = element->getPropertyValue(property, access);
    if (refers)
        collection.getValue<ReferenceCollection&>().getGenericInterface()->genericAdd(member);
    else
        collection.getValue<AbstractPrimitiveCollection&>().genericAdd(
            someValue(property->getType()));
}

/// The class whose elements a property of `metaClass` refers to; empty if they hold plain values.
meta::Class memberClassOf(meta::Class const& metaClass)
{
    for (auto const& [name, property] : metaClass->getOwnedAttributes())
        return meta::Class::cast(property->getType());
    return meta::Class();
}

/// What each of the properties of `metaClass` takes.
struct Bytes
{
    double element = 0;  ///< The whole element with properties that are empty.
    double value = 0;    ///< What a value adds to a property.
};

Bytes bytesOf(meta::Class const& metaClass, Make const& make)
{
    Model const model = Model::create(ModelConstellation());
    std::vector<ModelElement> elements;
    elements.reserve(COUNT);
    std::size_t const before = liveBytes();
    for (std::int64_t i = 0; i < COUNT; ++i)
        elements.push_back(make(model, metaClass));
    Bytes bytes;
    bytes.element = static_cast<double>(liveBytes() - before) / COUNT;

    std::vector<ModelElement> members;
    if (meta::Class const memberClass = memberClassOf(metaClass))
    {
        for (std::size_t i = 0; i < COUNT * PROPERTIES; ++i)
            members.push_back(make(model, memberClass));
    }
    std::size_t const empty = liveBytes();
    std::size_t next = 0;
    for (ModelElement const& element : elements)
    {
        for (auto const& [name, property] : metaClass->getOwnedAttributes())
            fill(element, property, members.empty() ? ModelElement() : members[next++]);
    }
    bytes.value = static_cast<double>(liveBytes() - empty) / COUNT / PROPERTIES;
    model->destroy();
    return bytes;
}

void propertyBytes(benchmark::State& state, meta::Class const& metaClass, Make const& make)
{
    meta::Package const package = metaClass->getOwningPackage();
    meta::Class const bare = meta::Class::cast(package->getOwnedTypes().find(u"Member"));
    for (auto _ : state)
    {
        double const without = bytesOf(bare, make).element;
        Bytes const bytes = bytesOf(metaClass, make);
        state.counters["bare"] = without;
        state.counters["empty"] = (bytes.element - without) / PROPERTIES;
        state.counters["value"] = bytes.value;
    }
}

void registerAll()
{
    meta::Package const package = kinds::Member::metaClass()->getOwningPackage();
    for (auto const& [name, type] : package->getOwnedTypes())
    {
        meta::Class const metaClass = meta::Class::cast(type);
        if (!metaClass || metaClass->getOwnedAttributes().size() != PROPERTIES)
            continue;
        std::string const kind = toUtf8(name);
        benchmark::RegisterBenchmark(
            ("BM_PropertyBytes_Generated/" + kind).c_str(),
            [=](benchmark::State& state) { propertyBytes(state, metaClass, makeGenerated); })
            ->Iterations(1);
        benchmark::RegisterBenchmark(
            ("BM_PropertyBytes_Reflective/" + kind).c_str(),
            [=](benchmark::State& state) { propertyBytes(state, metaClass, makeReflective); })
            ->Iterations(1);
    }
}
[[maybe_unused]] bool const registered = (registerAll(), true);
}  // namespace
}  // namespace benchkit
