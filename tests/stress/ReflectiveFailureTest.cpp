// Elements of classes without code when memory runs out: each creation, store and change of a
// collection is taken back by its transaction, nothing leaks, and the same succeeds afterwards.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericMapInterface.h"
#include "tarnkiln/collections/GenericMultimapInterface.h"
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/Text.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tests/stress/OutOfMemoryRounds.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/RuntimeMetamodel.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <algorithm>
#include <sstream>

namespace {

using namespace testkit;
using testing::IsEmpty;
using N = Node::Impl;

ustring const LONG_TEXT = u"a text that is too long to be kept in place";

/// A class with a single value of each kind, required and optional.
struct Kinds
{
    static Kinds const& get()
    {
        static Kinds const kinds;
        return kinds;
    }

    meta::Property one(char16_t const* name, meta::Type const& type)
    {
        return metamodel.property(record, name, type).required();
    }
    meta::Property maybe(char16_t const* name, meta::Type const& type)
    {
        return metamodel.property(record, name, type);
    }

    RuntimeMetamodel metamodel;
    meta::Class const record = metamodel.makeClass(u"Record");
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red", u"green"});
    meta::DataType const point = metamodel.makeDataType(u"Point");
    meta::Property const label = metamodel.field(point, u"label", StandardTypes::stringMeta);
    meta::Property const x = metamodel.field(point, u"x", StandardTypes::integerMeta);

    meta::Property const text = one(u"text", StandardTypes::stringMeta);
    meta::Property const bytes = one(u"bytes", StandardTypes::stdstringMeta);
    meta::Property const integer = one(u"integer", StandardTypes::integerMeta);
    meta::Property const tiny = one(u"tiny", StandardTypes::integer8Meta);
    meta::Property const wide = one(u"wide", StandardTypes::integer64Meta);
    meta::Property const real = one(u"real", StandardTypes::realMeta);
    meta::Property const flag = one(u"flag", StandardTypes::booleanMeta);
    meta::Property const uuid = one(u"uuid", StandardTypes::uuidMeta);
    meta::Property const time = one(u"time", StandardTypes::dateTimeMeta);
    meta::Property const tint = one(u"tint", colour);
    meta::Property const place = one(u"place", point);
    meta::Property const maybeText = maybe(u"maybeText", StandardTypes::stringMeta);
    meta::Property const maybeInteger = maybe(u"maybeInteger", StandardTypes::integerMeta);
    meta::Property const maybeWide = maybe(u"maybeWide", StandardTypes::integer64Meta);
    meta::Property const maybeReal = maybe(u"maybeReal", StandardTypes::realMeta);
    meta::Property const maybeUuid = maybe(u"maybeUuid", StandardTypes::uuidMeta);
    meta::Property const maybeTime = maybe(u"maybeTime", StandardTypes::dateTimeMeta);
    meta::Property const maybeTint = maybe(u"maybeTint", colour);
    meta::Property const places = metamodel.property(record, u"places", point).many().ordered();
};

meta::Property of(Slot const& slot)
{
    return slot.property();
}

GenericCollectionInterface& members(ModelElement const& element, Slot const& slot)
{
    return *referencesOf(element, of(slot)).getGenericInterface();
}

GenericSequenceInterface& sequence(ModelElement const& element, Slot const& slot)
{
    return dynamic_cast<GenericSequenceInterface&>(members(element, slot));
}

AbstractPrimitiveCollection& values(ModelElement const& element, Slot const& slot)
{
    return valuesOf(element, of(slot));
}

Value number(int payload)
{
    return Value(StandardTypes::integerMeta, payload);
}

Value text(ustring const& payload)
{
    return Value(StandardTypes::stringMeta, payload);
}

UUID uuid(std::uint8_t last)
{
    UUID result{};
    result.data[0] = 0x40;
    result.data[15] = last;
    return result;
}

/// A line for each entry; in the order of the lines if that of the entries says nothing.
std::string shown(ModelElement const& element, meta::Property const& property)
{
    Value const value = valueOf(element, property, ModelElement::Impl::NO_PROXY_RESOLVE);
    std::vector<std::string> entries;
    auto const add = [&](auto const& entry) {
        std::ostringstream out;
        out << entry;
        entries.push_back(out.str());
    };
    if (property->getUpper() < 2)
        add(value);
    else if (meta::Class::cast(property->getType()))
        for (ModelElement const& entry : referencesOf(element, property).getAllValuesAndProxies())
            add(entry);
    else
        for (Value const& entry : value.extractEntryValues())
            add(entry);
    if (!property->isOrdered())
        std::sort(entries.begin(), entries.end());
    std::string result = toUtf8(property->getName());
    for (std::string const& entry : entries)
        result += "\n    " + entry;
    return result;
}

/// Elements that are tied in all ways, and one with a value of each kind.
class World
{
public:
    World()
    {
        StandardTypes::ensureInitialized();
        record = ModelElement::createReflective(model, Kinds::get().record, uuid(99));
        std::uint8_t id = 0;
        for (ModelElement* const node : {&root, &other, &a, &b, &c, &d, &leaf, &part, &named})
            *node = make(++id);
        set(named, of(N::NAME), u"named");
        members(root, N::CHILDREN).genericAdd(a);
        members(root, N::CHILDREN).genericAdd(b);
        members(a, N::CHILDREN).genericAdd(leaf);
        members(root, N::PARTS).genericAdd(part);
        set(root, of(N::CORE), c);
        set(root, of(N::BODY), d);
        members(other, N::BY_NAME).genericAdd(named);
        set(a, of(N::LEFT), b);
        set(c, of(N::LEFT), d);
        set(a, of(N::OWNER), root);
        members(a, N::LINKS).genericAdd(b);
        members(b, N::LINKS).genericAdd(leaf);
        members(a, N::MARKS).genericAdd(leaf);
        set(b, of(N::GROUP), other);
        set(b, of(N::BUDDY), leaf);
        set(a, of(N::NAME), LONG_TEXT);
        values(a, N::NUMBERS).genericAdd(number(1));
        values(a, N::LABELS).genericAdd(text(u"label"));
        values(a, N::WORDS).genericAdd(text(u"word"));
    }

    ModelElement make(std::uint8_t id) const
    {
        return ModelElement::createReflective(model, NodeMetamodel::get().node, uuid(id));
    }
    /// Stores another value of the property `value` was made for.
    void store(meta::Property const& property, Value const& value) const
    {
        setValue(record, property, value);
    }
    template <class T> void store(meta::Property const& property, T const& payload) const
    {
        set(record, property, payload);
    }

    Picture picture() const
    {
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        Picture result;
        for (ModelElement const& element : model->getAllElements())
        {
            std::ostringstream out;
            out << element << " in " << element->container();
            for (meta::Class at = element->getMetaClass(); at; at = at->getSuperclass())
                for (auto const& [name, property] : at->getOwnedAttributes())
                    out << '\n' << shown(element, property);
            result.push_back(out.str());
        }
        std::sort(result.begin(), result.end());
        return result;
    }
    void expectUsable() const
    {
        EXPECT_EQ(nullptr, model->getCurrentTransaction());
        EXPECT_FALSE(model->isFrozen());
        std::size_t const count = model->getElementCount();
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        ModelElement const probe = make(200);
        set(probe, of(N::NAME), u"probe");
        values(probe, N::NUMBERS).genericAdd(number(7));
        for (ModelElement const& node : {root, a, leaf})
        {
            if (node)
                members(probe, N::LINKS).genericAdd(node);
        }
        EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
        EXPECT_EQ(count, model->getElementCount());
    }

    Model const model = Model::create(ModelConstellation());
    ModelElement root, other, a, b, c, d, leaf, part, named, record;
};

ReflectiveDataType pointOf(int x)
{
    ReflectiveDataType result(Kinds::get().point);
    result.setPropertyValue(Kinds::get().label,
                            Value(StandardTypes::stringMeta, boost::optional<ustring>(LONG_TEXT)));
    result.setPropertyValue(Kinds::get().x,
                            Value(StandardTypes::integerMeta, boost::optional<int>(x)));
    return result;
}

template <class T> boost::optional<T> some(T const& payload)
{
    return payload;
}

boost::posix_time::ptime someTime()
{
    return {boost::gregorian::date(2001, 2, 3), boost::posix_time::hours(4)};
}

WorldOperation<World> const OPERATIONS[] = {
    {"Create", [](World& w) { w.make(100); }},
    {"CreateARecord",
     [](World& w) { ModelElement::createReflective(w.model, Kinds::get().record, uuid(100)); }},
    {"SetAText", [](World& w) { w.store(Kinds::get().text, LONG_TEXT); }},
    {"SetBytes",
     [](World& w) { w.store(Kinds::get().bytes, string("bytes that are too long to be kept")); }},
    {"SetAnInteger", [](World& w) { w.store(Kinds::get().integer, 7); }},
    {"SetATinyInteger", [](World& w) { w.store(Kinds::get().tiny, static_cast<signed char>(7)); }},
    {"SetAWideInteger", [](World& w) { w.store(Kinds::get().wide, 7L); }},
    {"SetAReal", [](World& w) { w.store(Kinds::get().real, 7.5); }},
    {"SetAFlag", [](World& w) { w.store(Kinds::get().flag, true); }},
    {"SetAUuid", [](World& w) { w.store(Kinds::get().uuid, uuid(7)); }},
    {"SetATime", [](World& w) { w.store(Kinds::get().time, someTime()); }},
    {"SetAStructure",
     [](World& w) {
         w.store(Kinds::get().place, Value::createReflectiveDataTypeValue(pointOf(3)));
     }},
    {"SetALiteral",  // another one than the first by name, which is there from the start
     [](World& w) { w.store(Kinds::get().tint, Value(Kinds::get().colour, 0L)); }},
    {"SetAnOptionalText", [](World& w) { w.store(Kinds::get().maybeText, some(LONG_TEXT)); }},
    {"SetAnOptionalInteger", [](World& w) { w.store(Kinds::get().maybeInteger, some(7)); }},
    {"SetAnOptionalWideInteger", [](World& w) { w.store(Kinds::get().maybeWide, some(7L)); }},
    {"SetAnOptionalReal", [](World& w) { w.store(Kinds::get().maybeReal, some(7.5)); }},
    {"SetAnOptionalUuid", [](World& w) { w.store(Kinds::get().maybeUuid, some(uuid(7))); }},
    {"SetAnOptionalTime", [](World& w) { w.store(Kinds::get().maybeTime, some(someTime())); }},
    {"SetAnOptionalLiteral",
     [](World& w) {
         w.store(Kinds::get().maybeTint,
                 Value::createOptionalEnumValue(Kinds::get().maybeTint, 1L));
     }},
    {"AddAStructure",
     [](World& w) {
         valuesOf(w.record, Kinds::get().places)
             .genericAdd(Value::createReflectiveDataTypeValue(pointOf(4)));
     }},
    {"AddANumber", [](World& w) { values(w.a, N::NUMBERS).genericAdd(number(2)); }},
    {"AddTheFirstNumber", [](World& w) { values(w.b, N::NUMBERS).genericAdd(number(2)); }},
    {"AddALabel", [](World& w) { values(w.a, N::LABELS).genericAdd(text(LONG_TEXT)); }},
    {"ClearLabels", [](World& w) { values(w.a, N::LABELS).clear(); }},
    {"AddAWord", [](World& w) { values(w.a, N::WORDS).genericAdd(text(LONG_TEXT)); }},
    {"RenameAKeyedElement", [](World& w) { set(w.named, of(N::NAME), LONG_TEXT); }},
    {"RenameAGroupedElement", [](World& w) { set(w.b, of(N::NAME), LONG_TEXT); }},
    {"SetAReference", [](World& w) { set(w.a, of(N::BUDDY), w.other); }},
    {"ReferByAProxyAndReadThat",
     [](World& w) {
         ProxyId const id(ElementId::UUID_TYPE, u"40000000-0000-0000-0000-000000000007",
                          w.model->getModelURI());
         set(w.a, of(N::BUDDY), ModelElement::createProxy(w.model, NodeMetamodel::get().node, id));
         valueOf(w.a, of(N::BUDDY), ModelElement::Impl::PRIVILEGED_ACCESS);
     }},
    {"SetOneToOne", [](World& w) { set(w.a, of(N::LEFT), w.d); }},
    {"SetOneToOneFromTheOtherEnd", [](World& w) { set(w.b, of(N::RIGHT), w.c); }},
    {"ClearOneToOne", [](World& w) { set(w.a, of(N::LEFT), ModelElement()); }},
    {"AddToOneToMany", [](World& w) { members(w.other, N::OWNED).genericAdd(w.a); }},
    {"SetTheOwnerOfOneToMany", [](World& w) { set(w.a, of(N::OWNER), w.other); }},
    {"RemoveFromOneToMany", [](World& w) { members(w.root, N::OWNED).genericRemove(w.a); }},
    {"AddToManyToMany", [](World& w) { members(w.a, N::LINKS).genericAdd(w.leaf); }},
    {"InsertIntoManyToMany",
     [](World& w) { sequence(w.leaf, N::BACKLINKS).genericInsert(w.root, 0); }},
    {"ClearManyToMany", [](World& w) { members(w.b, N::LINKS).genericClear(); }},
    {"AddToASet", [](World& w) { members(w.a, N::MARKS).genericAdd(w.b); }},
    {"EraseFromASet", [](World& w) { members(w.a, N::MARKS).genericRemove(w.leaf); }},
    {"MoveAChildByItsContainer", [](World& w) { members(w.other, N::CHILDREN).genericAdd(w.a); }},
    {"MoveAChildByItself", [](World& w) { set(w.a, of(N::PARENT), w.other); }},
    {"ReleaseAChild", [](World& w) { set(w.a, of(N::PARENT), ModelElement()); }},
    {"ContainATopLevelElement", [](World& w) { members(w.leaf, N::CHILDREN).genericAdd(w.other); }},
    {"ReleaseAPart", [](World& w) { members(w.root, N::PARTS).genericRemove(w.part); }},
    {"ReplaceTheCore", [](World& w) { set(w.root, of(N::CORE), w.part); }},
    {"ReplaceTheBody", [](World& w) { set(w.root, of(N::BODY), w.leaf); }},
    {"SetTheHost", [](World& w) { set(w.leaf, of(N::HOST), w.root); }},
    {"MoveIntoAMap", [](World& w) { members(w.other, N::BY_NAME).genericAdd(w.leaf); }},
    {"LeaveAMap", [](World& w) { set(w.named, of(N::SCOPE), ModelElement()); }},
    {"MoveIntoAMultimap", [](World& w) { members(w.root, N::GROUPED).genericAdd(w.b); }},
    {"DestroyALeaf", [](World& w) { w.leaf->destroy(); }},
    {"DestroyATree", [](World& w) { w.root->destroy(); }},
    {"DestroyAMapWithItsContents", [](World& w) { w.other->destroy(); }},
    {"DestroyAllContents", [](World& w) { w.model->destroyAllContents(); }},
};

class ReflectiveElementsOutOfMemory : public testing::TestWithParam<WorldOperation<World>>
{
protected:
    OutOfMemoryRounds<World> const rounds{GetParam()};
};

INSTANTIATE_TEST_SUITE_P(Operations, ReflectiveElementsOutOfMemory, testing::ValuesIn(OPERATIONS),
                         testing::PrintToStringParamName());

TEST_P(ReflectiveElementsOutOfMemory, InATransactionComeBackWithIt)
{
    rounds.inATransaction();
}

TEST_P(ReflectiveElementsOutOfMemory, WhileATransactionIsRolledBackComeBackAllTheSame)
{
    rounds.whileRolledBack();
}
}  // namespace
