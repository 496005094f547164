// Keyed collections of reflective elements, and what changes of the key do to them.
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tests/meta/ReflectiveFixture.h"

namespace testkit {
namespace {

class ReflectiveKey : public ReflectiveFixture
{
protected:
    /// An element of class Item with that name.
    ModelElement item(ustring const& text)
    {
        ModelElement const made = make(itemClass);
        set(made, name, text);
        return made;
    }
    static Value key(ustring const& text) { return Value(StandardTypes::stringMeta, text); }

    meta::Class const box = metamodel.makeClass(u"Box");
    meta::Class const itemClass = metamodel.makeClass(u"Item");
    meta::Property const name =
        metamodel.property(itemClass, u"name", StandardTypes::stringMeta).required();
    meta::Property const friendOf = metamodel.property(itemClass, u"friend", itemClass);
    meta::Property const byName =
        metamodel.property(box, u"byName", itemClass).keyedBy(name).composite();
    meta::Property const scope = metamodel.property(itemClass, u"scope", box).opposite(byName);
    meta::Property const grouped = metamodel.property(box, u"grouped", itemClass).groupedBy(name);
    meta::Property const group = metamodel.property(itemClass, u"group", box).opposite(grouped);
    meta::Property const loose = metamodel.property(box, u"loose", itemClass).keyedBy(name);
    meta::Property const byFriend =
        metamodel.property(box, u"byFriend", itemClass).keyedBy(friendOf);
    meta::Property const friendScope =
        metamodel.property(itemClass, u"friendScope", box).opposite(byFriend);
};

TEST_F(ReflectiveKey, IsThatOfTheElementWhenItEnters)
{
    ModelElement const b = make(box), x = item(u"x"), y = item(u"y");

    set(x, scope, b);
    genericOf(b, byName).genericAdd(y);

    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"x")), x);
    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"y")), y);
    EXPECT_FALSE(mapOf(b, byName).genericFind(key(u"z")));
    EXPECT_THAT(mapOf(b, byName).genericKeys(), ElementsAre(key(u"x"), key(u"y")));
    EXPECT_EQ(mapOf(b, byName).getKeyType(), StandardTypes::stringMeta);
}

TEST_F(ReflectiveKey, IsFiledAnewWhenItChanges)
{
    ModelElement const b = make(box), x = item(u"x");
    set(x, scope, b);
    set(x, group, b);

    set(x, name, u"new");

    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"new")), x);
    EXPECT_FALSE(mapOf(b, byName).genericFind(key(u"x")));
    EXPECT_THAT(multimapOf(b, grouped).genericFind(key(u"new")), ElementsAre(x));
    EXPECT_EQ(targetOf(x, scope), b);
    EXPECT_EQ(x->container(), b);
}

TEST_F(ReflectiveKey, ThatIsTakenIsRefusedAndTheElementStaysWhereItWas)
{
    ModelElement const b = make(box), x = item(u"x"), y = item(u"y");
    set(x, scope, b);
    set(y, scope, b);
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = begin();

    EXPECT_RAISES(messages::UniquenessConstraint, set(x, name, u"y"));

    EXPECT_EQ(get<ustring>(x, name), u"x");
    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"x")), x);
    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"y")), y);
    transaction.commit();
    EXPECT_THAT(listener.committed, IsEmpty());
}

TEST_F(ReflectiveKey, ThatIsTakenKeepsAnElementOut)
{
    ModelElement const b = make(box), x = item(u"same"), y = item(u"same");
    set(x, scope, b);

    EXPECT_RAISES(messages::UniquenessConstraint, set(y, scope, b));
    EXPECT_RAISES(messages::UniquenessConstraint, genericOf(b, byName).genericAdd(y));

    EXPECT_TRUE(y->isTopLevel());
    EXPECT_THAT(entriesOf(b, byName), ElementsAre(x));
    set(x, group, b);
    set(y, group, b);
    EXPECT_THAT(multimapOf(b, grouped).genericFind(key(u"same")), ElementsAre(x, y))
        << "a multimap takes both";
    EXPECT_THAT(multimapOf(b, grouped).genericKeys(), ElementsAre(key(u"same")));
}

TEST_F(ReflectiveKey, IsNotFiledAnewWithoutAnOpposite)
{
    ModelElement const b = make(box), x = item(u"x");
    genericOf(b, loose).genericAdd(x);

    set(x, name, u"new");

    EXPECT_EQ(mapOf(b, loose).genericFind(key(u"x")), x);
    EXPECT_FALSE(mapOf(b, loose).genericFind(key(u"new")));
}

TEST_F(ReflectiveKey, ChangesInADeepTransactionAndBackInTheOrderOfTheEntries)
{
    ModelElement const b = make(box), x = item(u"x");
    set(x, scope, b);
    Transaction const transaction = begin();

    set(x, name, u"new");
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(get<ustring>(x, name), u"x");
    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"x")), x);
    EXPECT_FALSE(mapOf(b, byName).genericFind(key(u"new")));
}

TEST_F(ReflectiveKey, ChangesInTheMiddleOfAParse)
{
    ModelElement const b = make(box), x = item(u"x");
    set(x, group, b);
    {
        Model::ParseInProgressIndicator const parsing(model);
        set(x, name, u"new");
    }

    EXPECT_THAT(multimapOf(b, grouped).genericFind(key(u"new")), ElementsAre(x));
}

TEST_F(ReflectiveKey, DoesNotChangeWithoutATransactionWhereOneIsNeeded)
{
    ModelElement const b = make(box), x = item(u"x");
    set(x, scope, b);
    ScriptedListener listener;
    listen(model, listener);

    EXPECT_RAISES(messages::NoOpenTransaction, set(x, name, u"new"));

    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"x")), x) << "it never left";
    EXPECT_THAT(listener.committed, IsEmpty());
}

TEST_F(ReflectiveKey, OfAnOptionalQualifierMustBeThere)
{
    meta::Class const tagged = metamodel.makeClass(u"Tagged");
    meta::Property const tag = metamodel.property(tagged, u"tag", StandardTypes::stringMeta);
    meta::Property const byTag = metamodel.property(box, u"byTag", tagged).keyedBy(tag);
    meta::Property const holder = metamodel.property(tagged, u"holder", box).opposite(byTag);
    meta::Property const manyByTag = metamodel.property(box, u"manyByTag", tagged).groupedBy(tag);
    meta::Property const manyHolder =
        metamodel.property(tagged, u"manyHolder", box).opposite(manyByTag);
    ModelElement const b = make(box), x = make(tagged), y = make(tagged);

    for (meta::Property const& reference : {holder, manyHolder})
    {
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, set(x, reference, b), u"String");
        EXPECT_FALSE(targetOf(x, reference));
    }
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, genericOf(b, byTag).genericAdd(x),
                       u"String");

    set(x, tag, boost::optional<ustring>(u"t"));
    set(x, holder, b);
    set(x, manyHolder, b);
    EXPECT_EQ(mapOf(b, byTag).genericFind(key(u"t")), x);
    set(y, tag, boost::optional<ustring>(u"t"));
    EXPECT_RAISES(messages::UniquenessConstraint, set(y, holder, b));
    set(y, tag, boost::optional<ustring>(u"u"));
    set(y, holder, b);
    EXPECT_RAISES(messages::UniquenessConstraint, set(y, tag, boost::optional<ustring>(u"t")));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, clear(x, tag), u"String");
    EXPECT_EQ(mapOf(b, byTag).genericFind(key(u"t")), x);
    EXPECT_THAT(multimapOf(b, manyByTag).genericFind(key(u"t")), ElementsAre(x));
}

TEST_F(ReflectiveKey, OfAClassIsTheUuidOfTheElementAndNilForNone)
{
    ModelElement const b = make(box), x = item(u"x"), y = item(u"y"), z = item(u"z");
    Value const nil(StandardTypes::uuidMeta, UUID());
    auto const uuidOf = [](ModelElement const& element) {
        return Value(StandardTypes::uuidMeta, element->getUuid());
    };

    set(x, friendScope, b);
    EXPECT_EQ(mapOf(b, byFriend).genericFind(nil), x);
    EXPECT_EQ(mapOf(b, byFriend).getKeyType(), itemClass);
    EXPECT_RAISES(messages::UniquenessConstraint, set(y, friendScope, b));

    set(x, friendOf, z);
    EXPECT_EQ(mapOf(b, byFriend).genericFind(uuidOf(z)), x);
    EXPECT_FALSE(mapOf(b, byFriend).genericFind(nil));
    EXPECT_THAT(mapOf(b, byFriend).genericKeys(), ElementsAre(uuidOf(z)));

    set(y, friendScope, b);
    EXPECT_RAISES(messages::UniquenessConstraint, set(y, friendOf, z));
    EXPECT_RAISES(messages::UniquenessConstraint, clear(x, friendOf));
    EXPECT_EQ(mapOf(b, byFriend).genericFind(nil), y);
    EXPECT_EQ(targetOf(x, friendOf), z);
}

TEST_F(ReflectiveKey, OfAnElementThatIsDestroyedIsFreeAgain)
{
    ModelElement const b = make(box), x = item(u"x"), z = item(u"z");
    set(x, scope, b);
    set(x, friendOf, z);
    set(x, friendScope, b);

    x->destroy();

    EXPECT_THAT(entriesOf(b, byName), IsEmpty());
    EXPECT_THAT(entriesOf(b, byFriend), IsEmpty());
}

TEST_F(ReflectiveKey, OfAnElementThatComesBackIsTakenAgain)
{
    ModelElement const b = make(box), x = item(u"x"), z = item(u"z");
    set(x, scope, b);
    set(x, friendOf, z);
    set(x, friendScope, b);
    Transaction const transaction = begin();

    x->destroy();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(mapOf(b, byName).genericFind(key(u"x")), x);
    EXPECT_EQ(mapOf(b, byFriend).genericFind(Value(StandardTypes::uuidMeta, z->getUuid())), x);
    EXPECT_EQ(targetOf(x, friendOf), z);
}

TEST_F(ReflectiveKey, IsUnwrappedFromASingleElementOnly)
{
    ModelElement const x = item(u"x");
    auto const unwrap = [](Value const& value) {
        return ReflectiveModelElementImpl::unwrapKey(value);
    };

    EXPECT_EQ(unwrap(Value(itemClass, x)), Value(StandardTypes::uuidMeta, x->getUuid()));
    EXPECT_EQ(unwrap(Value(itemClass, ModelElement())), Value(StandardTypes::uuidMeta, UUID()));
    EXPECT_EQ(unwrap(key(u"x")), key(u"x"));
    Value const collection = valueOf(make(box), byName);
    EXPECT_EQ(unwrap(collection), collection);
    x->destroy();
    EXPECT_EQ(unwrap(Value(itemClass, x)), Value(StandardTypes::uuidMeta, UUID()));
}

TEST_F(ReflectiveKey, IsCheckedWhereOneElementAKeyIsKept)
{
    ModelElement const b = make(box), x = item(u"x");
    set(x, scope, b);
    set(x, group, b);
    auto const check = [&](ModelElement const& owner, meta::Property const& collection,
                           ustring const& text) {
        ReflectiveModelElementImpl::checkUniqueness(owner, collection, key(text));
    };

    EXPECT_RAISES(messages::UniquenessConstraint, check(b, byName, u"x"));
    check(b, byName, u"free");
    check(b, grouped, u"x");
    check(ModelElement(), byName, u"x");
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, check(x, scope, u"x"));
}
}  // namespace
}  // namespace testkit
