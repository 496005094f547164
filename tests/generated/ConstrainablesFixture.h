/// \file
/// Queries by typed search instances over the generated classes.
#pragma once
#include "tarnkiln/query/AbstractQuery.h"
#include "tarnkiln/query/Messages.h"
#include "tarnkiln/query/Results.h"
#include "tests/generated/ShapesFixture.h"

namespace testkit::shapes {

using query::AbstractQuery;
using query::SearchClassMatchMode;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

class QueriedShapes : public ShapesTest
{
protected:
    /// The elements of `C` for which all constraints hold that `state` puts on a search instance.
    template <class C, class State> std::vector<C> found(State const& state) const
    {
        AbstractQuery query(m_model);
        typename C::Constrainables const sought({query, SearchClassMatchMode::MatchSubclasses});
        state(sought);
        std::vector<C> result;
        for (auto const& [element] : query.results(sought))
            result.push_back(element);
        return result;
    }
};
}  // namespace testkit::shapes
