#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <unordered_set>

namespace tarn::kiln::meta {

namespace {

/// Up to here nothing is remembered that would tell a ring.
constexpr int USUAL_DEPTH = 64;

/// Whether `wanted` is `from` or above it. A description may close the superclasses to a ring,
/// which holds nothing more after one round.
bool isOnChain(Class::Impl const* from, Type::Impl const* wanted)
{
    Class::Impl const* at = from;
    for (int depth = 0; at && depth < USUAL_DEPTH; ++depth, at = at->getSuperclassImpl())
    {
        if (at == wanted)
            return true;
    }
    std::unordered_set<Class::Impl const*> seen;
    for (; at && seen.insert(at).second; at = at->getSuperclassImpl())
    {
        if (at == wanted)
            return true;
    }
    return false;
}

/// What `ask` answers for the first class from `from` upward for which it answers anything.
template <class Ask> auto firstOnChain(Class::Impl const* from, Ask ask) -> decltype(ask(*from))
{
    std::unordered_set<Class::Impl const*> seen;
    Class above;
    int depth = 0;
    for (Class::Impl const* at = from; at; at = above.getImpl())
    {
        if (++depth > USUAL_DEPTH && !seen.insert(at).second)
            break;
        if (auto answer = ask(*at); answer != decltype(answer)())
            return answer;
        above = at->getSuperclass();
        if (!above)
            break;
    }
    return {};
}
}  // namespace

bool Class::Impl::isA(Type const& other) const
{
    return isOnChain(this, other.getImpl());
}

bool Class::Impl::isATypeOf(Property const& property) const
{
    return property && property->getOwningTypeImpl() &&
           isOnChain(this, property->getOwningTypeImpl());
}

Property Class::Impl::getPropertyByName(ustring const& name) const
{
    return firstOnChain(this, [&](Class::Impl const& owner) {
        Property const found = owner.StructuredType::Impl::getPropertyByName(name);
        return found ? found : Property();
    });
}

std::vector<Operation> Class::Impl::getOperationsByName(ustring const& name) const
{
    return firstOnChain(this, [&](Class::Impl const& owner) {
        return owner.StructuredType::Impl::getOperationsByName(name);
    });
}

std::unique_ptr<ModelElement::Builder> Class::Impl::instantiateBuilder(Model const& model) const
{
    Class const self(const_cast<Impl*>(this));
    return MetaRegistry::getInstance().instantiateBuilder(self, model);
}

ModelElement Class::Impl::instantiate(Model const& model, UUID const& id) const
{
    std::unique_ptr<ModelElement::Builder> const builder = instantiateBuilder(model);
    return builder ? builder->create(id) : ModelElement();
}
}  // namespace tarn::kiln::meta
