// What is asked of plain properties by the members of search instances.
#include "shapes/DefaultsImpl.h"
#include "shapes/GuardedConstrainables.h"
#include "shapes/NodeImpl.h"
#include "shapes/NoteConstrainables.h"
#include "shapes/NoteImpl.h"
#include "shapes/OptionalsConstrainables.h"
#include "shapes/OptionalsImpl.h"
#include "shapes/ScalarsConstrainables.h"
#include "shapes/ScalarsImpl.h"
#include "shapes/ValuesConstrainables.h"
#include "shapes/ValuesImpl.h"
#include "shapes/VaultConstrainables.h"
#include "shapes/VaultImpl.h"
#include "tests/generated/ConstrainablesFixture.h"

#include <boost/date_time/posix_time/posix_time.hpp>

namespace testkit::shapes {
namespace {

boost::posix_time::ptime hour(int hour)
{
    return {boost::gregorian::date(2026, 11, 21), boost::posix_time::hours(hour)};
}

class ValueConstraint : public QueriedShapes
{
protected:
    /// Three `Scalars` with the values in one property, which is then asked for the middle one.
    template <class Member, class Setter, class V>
    void tryAllRelations(Member member, Setter setter, V const& low, V const& middle, V const& high)
    {
        Scalars const a = Scalars::create(m_model);
        Scalars const b = Scalars::create(m_model);
        Scalars const c = Scalars::create(m_model);
        (a.getImpl()->*setter)(low);
        (b.getImpl()->*setter)(middle);
        (c.getImpl()->*setter)(high);

        tryRelations<Scalars>(member, middle, a, b, c);
        destroyAll({a, b, c});
    }
    /// The same of an optional property; a fourth element has no value and suits nothing.
    template <class Member, class Setter, class V>
    void tryAllRelationsOfOptional(Member member, Setter setter, V const& low, V const& middle,
                                   V const& high)
    {
        Optionals const a = Optionals::create(m_model);
        Optionals const b = Optionals::create(m_model);
        Optionals const c = Optionals::create(m_model);
        Optionals const absent = Optionals::create(m_model);
        (a.getImpl()->*setter)(low);
        (b.getImpl()->*setter)(middle);
        (c.getImpl()->*setter)(high);

        auto const ask = [&](auto const& state) { return found<Optionals>(state); };
        EXPECT_THAT(ask([&](auto const& each) { each.*member == middle; }), ElementsAre(b));
        EXPECT_THAT(ask([&](auto const& each) { each.*member != middle; }),
                    UnorderedElementsAre(a, c, absent));
        EXPECT_THAT(ask([&](auto const& each) { each.*member == boost::none; }),
                    ElementsAre(absent));
        EXPECT_THAT(ask([&](auto const& each) { each.*member != boost::none; }),
                    UnorderedElementsAre(a, b, c));
        EXPECT_THAT(ask([&](auto const& each) { each.*member == boost::optional<V>(high); }),
                    ElementsAre(c));
        EXPECT_THAT(ask([&](auto const& each) { each.*member == boost::optional<V>(); }),
                    ElementsAre(absent));
        tryOrder<Optionals>(member, middle, a, b, c);
        destroyAll({a, b, c, absent});
    }

private:
    template <class C, class Member, class V>
    void tryRelations(Member member, V const& middle, C const& a, C const& b, C const& c)
    {
        auto const ask = [&](auto const& state) { return found<C>(state); };
        EXPECT_THAT(ask([&](auto const& each) { each.*member == middle; }), ElementsAre(b));
        EXPECT_THAT(ask([&](auto const& each) { each.*member != middle; }),
                    UnorderedElementsAre(a, c));
        tryOrder<C>(member, middle, a, b, c);
    }
    template <class C, class Member, class V>
    void tryOrder(Member member, V const& middle, C const& a, C const& b, C const& c)
    {
        auto const ask = [&](auto const& state) { return found<C>(state); };
        EXPECT_THAT(ask([&](auto const& each) { each.*member < middle; }), ElementsAre(a));
        EXPECT_THAT(ask([&](auto const& each) { each.*member <= middle; }),
                    UnorderedElementsAre(a, b));
        EXPECT_THAT(ask([&](auto const& each) { each.*member > middle; }), ElementsAre(c));
        EXPECT_THAT(ask([&](auto const& each) { each.*member >= middle; }),
                    UnorderedElementsAre(b, c));
    }
    static void destroyAll(std::vector<ModelElement> const& elements)
    {
        for (ModelElement const& element : elements)
            element->destroy();
    }
};

TEST_F(ValueConstraint, ComparesNumbersOfAllTypes)
{
    using S = Scalars::Constrainables;
    tryAllRelations(&S::integer, &Scalars::Impl::setInteger, -3, 5, 7);
    tryAllRelations<decltype(&S::integer8), decltype(&Scalars::Impl::setInteger8), signed char>(
        &S::integer8, &Scalars::Impl::setInteger8, -128, 5, 127);
    tryAllRelations<decltype(&S::integer16), decltype(&Scalars::Impl::setInteger16), short>(
        &S::integer16, &Scalars::Impl::setInteger16, -300, 5, 300);
    tryAllRelations(&S::integer64, &Scalars::Impl::setInteger64, -1L << 40, 5L, 1L << 40);
    tryAllRelations(&S::natural, &Scalars::Impl::setNatural, 1u, 5u, 0xFFFFFFFFu);
    tryAllRelations<decltype(&S::unsigned8), decltype(&Scalars::Impl::setUnsigned8), unsigned char>(
        &S::unsigned8, &Scalars::Impl::setUnsigned8, 1, 5, 255);
    tryAllRelations<decltype(&S::unsigned16), decltype(&Scalars::Impl::setUnsigned16),
                    unsigned short>(&S::unsigned16, &Scalars::Impl::setUnsigned16, 1, 5, 65535);
    tryAllRelations(&S::unsigned64, &Scalars::Impl::setUnsigned64, 1ul, 5ul, ~0ul);
    tryAllRelations(&S::real, &Scalars::Impl::setReal, -0.5, 0.25, 7.5);
}

TEST_F(ValueConstraint, ComparesTextsIdentifiersAndTimes)
{
    using S = Scalars::Constrainables;
    tryAllRelations(&S::text, &Scalars::Impl::setText, ustring(u"Ann"), ustring(u"Bob"),
                    ustring(u"Cid"));
    tryAllRelations(&S::bytes, &Scalars::Impl::setBytes, string("Ann"), string("Bob"),
                    string("Cid"));
    tryAllRelations(&S::id, &Scalars::Impl::setId, UUID{{1}}, UUID{{2}}, UUID{{3}});
    tryAllRelations(&S::time, &Scalars::Impl::setTime, hour(1), hour(2), hour(3));
}

TEST_F(ValueConstraint, ComparesOptionalValuesOfAllTypes)
{
    using O = Optionals::Constrainables;
    using Impl = Optionals::Impl;
    tryAllRelationsOfOptional(&O::text, &Impl::setText, ustring(u"A"), ustring(u"B"),
                              ustring(u"C"));
    tryAllRelationsOfOptional(&O::bytes, &Impl::setBytes, string("A"), string("B"), string("C"));
    tryAllRelationsOfOptional(&O::integer, &Impl::setInteger, -1, 0, 1);
    tryAllRelationsOfOptional<decltype(&O::integer8), decltype(&Impl::setInteger8), signed char>(
        &O::integer8, &Impl::setInteger8, -1, 0, 1);
    tryAllRelationsOfOptional<decltype(&O::integer16), decltype(&Impl::setInteger16), short>(
        &O::integer16, &Impl::setInteger16, -1, 0, 1);
    tryAllRelationsOfOptional(&O::integer64, &Impl::setInteger64, -1L, 0L, 1L);
    tryAllRelationsOfOptional(&O::natural, &Impl::setNatural, 0u, 1u, 2u);
    tryAllRelationsOfOptional<decltype(&O::unsigned8), decltype(&Impl::setUnsigned8),
                              unsigned char>(&O::unsigned8, &Impl::setUnsigned8, 0, 1, 2);
    tryAllRelationsOfOptional<decltype(&O::unsigned16), decltype(&Impl::setUnsigned16),
                              unsigned short>(&O::unsigned16, &Impl::setUnsigned16, 0, 1, 2);
    tryAllRelationsOfOptional(&O::unsigned64, &Impl::setUnsigned64, 0ul, 1ul, 2ul);
    tryAllRelationsOfOptional(&O::real, &Impl::setReal, -1.5, 0.0, 1.5);
    tryAllRelationsOfOptional(&O::id, &Impl::setId, UUID{{1}}, UUID{{2}}, UUID{{3}});
    tryAllRelationsOfOptional(&O::time, &Impl::setTime, hour(1), hour(2), hour(3));
}

TEST_F(ValueConstraint, ComparesBooleans)
{
    Scalars const off = Scalars::create(m_model);
    Scalars const on = Scalars::create(m_model);
    on->setIsSet(true);

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.isSet == true; }), ElementsAre(on));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.isSet != true; }), ElementsAre(off));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.isSet < true; }), ElementsAre(off));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.isSet >= true; }), ElementsAre(on));
}

TEST_F(ValueConstraint, TakesTextsInEveryForm)
{
    Scalars const emma = Scalars::create(m_model);
    emma->setText(u"Emma");
    emma->setBytes("Emma");
    Scalars::create(m_model);

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text == u"Emma"; }), ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text == std::u16string_view(u"Emma"); }),
                ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) {
                    char16_t const* const pointer = u"Emma";
                    each.text == pointer;
                }),
                ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes == "Emma"; }), ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes == std::string_view("Emma"); }),
                ElementsAre(emma));
}

TEST_F(ValueConstraint, TakesNumbersOfEveryTypeThatFit)
{
    Scalars const five = Scalars::create(m_model);
    five->setInteger8(5);
    five->setUnsigned64(5);
    five->setReal(5);
    Scalars::create(m_model);

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.integer8 == 5ul; }), ElementsAre(five));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.unsigned64 > 4; }), ElementsAre(five));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.real == 5; }), ElementsAre(five));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.real > 4.5f; }), ElementsAre(five));
}

TEST_F(ValueConstraint, RefusesANumberThatThePropertyCanNotHold)
{
    AbstractQuery query(m_model);
    Scalars::Constrainables const scalars({query, SearchClassMatchMode::MatchExactClass});
    Optionals::Constrainables const optionals({query, SearchClassMatchMode::MatchExactClass});

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, scalars.integer8 < 128, u"Integer8");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, scalars.natural == -1,
                       u"UnlimitedNatural");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       optionals.unsigned8 == boost::optional<int>(256), u"UInteger8");
    EXPECT_TRUE(query.results(scalars).begin() == query.results(scalars).end());
}

TEST_F(ValueConstraint, ComparesLiteralsOfEnumerations)
{
    Scalars const red = Scalars::create(m_model);
    red->setColour(Colour::Red);
    Scalars const fresh = Scalars::create(m_model);
    fresh->setColour(Colour::BrandNew);

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.colour == Colour::BrandNew; }),
                ElementsAre(fresh));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.colour != Colour::BrandNew; }),
                ElementsAre(red));
}

TEST_F(ValueConstraint, ComparesOptionalLiteralsAsTheirTableSays)
{
    Optionals const red = Optionals::create(m_model);
    red->setColour(Colour::Red);
    Optionals const green = Optionals::create(m_model);
    green->setColour(Colour::Green);
    Optionals const absent = Optionals::create(m_model);

    EXPECT_THAT(found<Optionals>([](auto const& each) { each.colour == Colour::Red; }),
                ElementsAre(red));
    EXPECT_THAT(found<Optionals>([](auto const& each) { each.colour != Colour::Red; }),
                ElementsAre(green));
    EXPECT_THAT(found<Optionals>([](auto const& each) { each.colour == boost::none; }),
                ElementsAre(absent));
    EXPECT_THAT(found<Optionals>([](auto const& each) { each.colour != boost::none; }),
                ElementsAre(absent));
}

TEST_F(ValueConstraint, ComparesLiteralsOfTheMetamodelOfMetamodels)
{
    Note const note = Note::create(m_model);
    note->setLanguage(meta::Language::JavaScript);
    note->setName(u"n");
    Note::create(m_model);

    EXPECT_THAT(found<Note>([](auto const& each) { each.language == meta::Language::JavaScript; }),
                ElementsAre(note));
    EXPECT_THAT(found<Note>([](auto const& each) { each.name == u"n"; }), ElementsAre(note));
}

TEST_F(ValueConstraint, MatchesLikePatterns)
{
    Scalars const emma = Scalars::create(m_model);
    emma->setText(u"Emma");
    emma->setBytes("Emma");
    Scalars const other = Scalars::create(m_model);
    other->setText(u"Persuasion (2)");
    other->setBytes("Persuasion (2)");

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text.like(u"E%a"); }),
                ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text.like(u"(_)"); }),
                ElementsAre(other));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes.like("Em_a"); }),
                ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes.like(string("(_)")); }),
                IsEmpty());
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes.like("%(_)"); }),
                ElementsAre(other));
}

TEST_F(ValueConstraint, MatchesRegularExpressions)
{
    Scalars const emma = Scalars::create(m_model);
    emma->setText(u"Emma");
    emma->setBytes("Emma");
    Scalars::create(m_model);

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text.regexp(u"m+"); }),
                ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text.regexp(u"^m+$"); }), IsEmpty());
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes.regexp("E[ma]*"); }),
                ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes.regexp("m+"); }), IsEmpty());
    EXPECT_THROW(found<Scalars>([](auto const& each) { each.text.regexp(u"("); }),
                 std::runtime_error);
    EXPECT_THROW(found<Scalars>([](auto const& each) { each.bytes.regexp("("); }),
                 std::runtime_error);
}

TEST_F(ValueConstraint, ComparesTextsWithoutCase)
{
    Scalars const emma = Scalars::create(m_model);
    emma->setText(u"Emma");
    emma->setBytes("Emma");
    Scalars::create(m_model);
    Optionals const optional = Optionals::create(m_model);
    optional->setText(ustring(u"Emma"));
    optional->setBytes(string("Emma"));
    Optionals::create(m_model);

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text.equalNoCase(u"EMMA"); }),
                ElementsAre(emma));
    EXPECT_THAT(found<Scalars>([](auto const& each) { each.bytes.equalNoCase("eMMa"); }),
                ElementsAre(emma));
    EXPECT_THAT(found<Optionals>([](auto const& each) { each.text.equalNoCase(u"emma"); }),
                ElementsAre(optional));
    EXPECT_THAT(found<Optionals>([](auto const& each) { each.bytes.equalNoCase("emma"); }),
                ElementsAre(optional));
}

TEST_F(ValueConstraint, NeedsOneOfManyValues)
{
    Values const low = Values::create(m_model);
    low->getNumbers().push_back(1);
    low->getNumbers().push_back(2);
    low->getLabels().push_back(u"shared");
    low->getWords().insert(u"low");
    low->getColours().push_back(Colour::Red);
    Values const high = Values::create(m_model);
    high->getNumbers().push_back(2);
    high->getNumbers().push_back(9);
    high->getLabels().push_back(u"shared");
    high->getWords().insert(u"high");
    high->getPalette().insert(Colour::Green);
    Values::create(m_model);

    EXPECT_THAT(found<Values>([](auto const& each) { each.numbers == 2; }),
                UnorderedElementsAre(low, high));
    EXPECT_THAT(found<Values>([](auto const& each) { each.numbers == 9; }), ElementsAre(high));
    EXPECT_THAT(found<Values>([](auto const& each) { each.numbers != 2; }),
                UnorderedElementsAre(low, high));
    EXPECT_THAT(found<Values>([](auto const& each) { each.numbers < 2; }), ElementsAre(low));
    EXPECT_THAT(found<Values>([](auto const& each) { each.numbers > 2; }), ElementsAre(high));
    EXPECT_THAT(found<Values>([](auto const& each) { each.labels == u"shared"; }),
                UnorderedElementsAre(low, high));
    EXPECT_THAT(found<Values>([](auto const& each) { each.words == u"low"; }), ElementsAre(low));
    EXPECT_THAT(found<Values>([](auto const& each) { each.words.equalNoCase(u"HIGH"); }),
                ElementsAre(high));
    EXPECT_THAT(found<Values>([](auto const& each) { each.colours == Colour::Red; }),
                ElementsAre(low));
    EXPECT_THAT(found<Values>([](auto const& each) { each.palette == Colour::Green; }),
                ElementsAre(high));
    EXPECT_THAT(found<Values>([](auto const& each) { each.numbers == boost::none; }), IsEmpty());
}

TEST_F(ValueConstraint, MustHoldTogetherWithAllOthers)
{
    for (int number = 0; number < 5; ++number)
        Scalars::create(m_model)->setInteger(number);

    auto const rows = found<Scalars>([](auto const& each) {
        each.integer > 1;
        each.integer <= 3;
        each.integer != 2;
    });

    ASSERT_EQ(rows.size(), 1u);
    EXPECT_EQ(rows[0]->getInteger(), 3);
}

TEST_F(ValueConstraint, ReachesHiddenAndRenamedProperties)
{
    Vault const vault = Vault::create(m_model);
    vault->setHidden(7);
    vault->setFallback(4);
    Vault::create(m_model);

    EXPECT_THAT(found<Vault>([](auto const& each) { each.hidden == 7; }), ElementsAre(vault));
    EXPECT_THAT(found<Vault>([](auto const& each) { each.fallback == 4; }), ElementsAre(vault));
}

TEST_F(ValueConstraint, ReachesPropertiesThatAreNamedLikeTypes)
{
    Node const node = Node::create(m_model);
    Note const note = Note::create(m_model);
    note->setString("text");
    note->setNode(node);
    Note::create(m_model);

    EXPECT_THAT(found<Note>([](auto const& each) { each.string == "text"; }), ElementsAre(note));
    EXPECT_THAT(found<Note>([&](auto const& each) { each.Node == node; }), ElementsAre(note));
}

TEST_F(ValueConstraint, IsRefusedAfterTheQueryWasReset)
{
    AbstractQuery query(m_model);
    Scalars::Constrainables const scalars({query, SearchClassMatchMode::MatchExactClass});
    query.getReflectiveQuery().reset();

    EXPECT_RAISES(tarnkiln::query::NoSuchInstanceId, scalars.integer == 1);
}
}  // namespace
}  // namespace testkit::shapes
