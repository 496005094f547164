#include "ElementText.h"

#include "OldValues.h"
#include "model/AlternativeImpl.h"
#include "model/DependencyGroupImpl.h"
#include "model/PackageImpl.h"
#include "model/ReleaseImpl.h"
#include "tarnkiln/meta/ClassImpl.h"

#include "sill/i18n/StringConversion.h"

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_string;

namespace {

/// Tries one class after the other; a destroyed element still has its class.
template <class... Classes> std::string textAsOneOf(ModelElement const& element, Before before)
{
    std::string text;
    auto const matches = [&](auto const& typed) {
        return typed.getImpl() && (text = textOf(typed, before), true);
    };
    static_cast<void>((matches(Classes::cast(element)) || ...));
    return text.empty() ? to_string(element->getMetaClass()->getName()) : text;
}

ModelElement targetOf(model::Alternative const& alternative, Before before)
{
    if (before && !alternative)
        return oldTarget(*before, alternative, model::Alternative::Impl::TARGET.property());
    return ModelElement(alternative->getTargetImpl());
}

std::vector<ModelElement> alternativesOf(model::DependencyGroup const& group, Before before)
{
    if (before && !group)
        return oldMembers(*before, group, model::DependencyGroup::Impl::ALTERNATIVES.property());
    return group->hasAlternatives() ? group->getAlternatives().getAllValues()
                                    : std::vector<ModelElement>();
}

}  // namespace

std::string textOf(model::Package const& package, Before /*before*/)
{
    if (package->isProxy())
        return "a package that is not in the file";
    return to_string(package->getName());
}

std::string textOf(model::Release const& release, Before /*before*/)
{
    auto const package = model::Package::cast(ModelElement(release->containerImpl()));
    std::string const name = package.getImpl() ? textOf(package) + ' ' : std::string();
    return name + to_string(release->getLabel());
}

std::string textOf(model::Alternative const& alternative, Before before)
{
    auto const target = model::Package::cast(targetOf(alternative, before));
    std::string const name = target.getImpl() ? textOf(target) : "nothing";
    if (alternative->getRelation().empty())
        return name;
    return name + " (" + to_string(alternative->getRelation()) + ' ' +
           to_string(alternative->getBound()) + ')';
}

std::string textOf(model::DependencyGroup const& group, Before before)
{
    std::string text = to_string(group->getKind()) + ':';
    char const* separator = " ";
    for (ModelElement const& alternative : alternativesOf(group, before))
    {
        text += separator + textOf(alternative, before);
        separator = " | ";
    }
    return text;
}

std::string textOf(ModelElement const& element, Before before)
{
    return textAsOneOf<model::Package, model::Release, model::DependencyGroup, model::Alternative>(
        element, before);
}

}  // namespace debian
