#include "ElementText.h"

#include "Dependencies.h"
#include "MissingNames.h"
#include "OldValues.h"
#include "tarnkiln/meta/ClassImpl.h"

#include "sill/i18n/StringConversion.h"

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_string;

namespace {

/// Tries one class after the other; a destroyed element still has its class.
template <ElementForm Form, class... Classes>
std::string textAsOneOf(ModelElement const& element, Before before)
{
    std::string text;
    auto const matches = [&](auto const& typed) {
        return typed.getImpl() && (text = textOf<Form>(typed, before), true);
    };
    static_cast<void>((matches(Classes::cast(element)) || ...));
    return text.empty() ? to_string(element->getMetaClass()->getName()) : text;
}

template <ElementForm Form>
ModelElement targetOf(Alternative<Form> const& alternative, Before before)
{
    if (before && !alternative)
        return oldTarget(*before, alternative, propertyOf(alternative, u"target"));
    return ModelElement(alternative->getTargetImpl());
}

template <ElementForm Form>
std::vector<Alternative<Form>> alternativesOf(DependencyGroup<Form> const& group, Before before)
{
    std::vector<Alternative<Form>> result;
    if (!before || group)
    {
        forEachAlternative<Form>(
            group, [&](Alternative<Form> const& alternative) { result.push_back(alternative); });
        return result;
    }
    for (ModelElement const& old : oldMembers(*before, group, propertyOf(group, u"alternatives")))
        result.push_back(Alternative<Form>::cast(old));
    return result;
}

}  // namespace

template <ElementForm Form>
std::string textOf(Package<Form> const& package, Before /*before*/, Missing missing)
{
    if (!package->isProxy())
        return to_string(package->getName());
    ModelElement const& proxy = package;
    return missing ? missing->nameOf(*proxy->getProxyId()) : "a package that is not in the file";
}

template <ElementForm Form> std::string textOf(Release<Form> const& release, Before /*before*/)
{
    auto const package = Package<Form>::cast(ModelElement(release->containerImpl()));
    std::string const name = package.getImpl() ? textOf<Form>(package) + ' ' : std::string();
    return name + to_string(release->getLabel());
}

template <ElementForm Form>
std::string textOf(Alternative<Form> const& alternative, Before before, Missing missing)
{
    auto const target = Package<Form>::cast(targetOf<Form>(alternative, before));
    std::string const name = target.getImpl() ? textOf<Form>(target, before, missing) : "nothing";
    if (alternative->getRelation().empty())
        return name;
    return name + " (" + to_string(alternative->getRelation()) + ' ' +
           to_string(alternative->getBound()) + ')';
}

template <ElementForm Form>
std::string textOf(DependencyGroup<Form> const& group, Before before, Missing missing)
{
    std::string text = to_string(group->getKind()) + ':';
    char const* separator = " ";
    for (Alternative<Form> const& alternative : alternativesOf<Form>(group, before))
    {
        text += separator + textOf<Form>(alternative, before, missing);
        separator = " | ";
    }
    return text;
}

template <ElementForm Form> std::string textOf(ModelElement const& element, Before before)
{
    return textAsOneOf<Form, Package<Form>, Release<Form>, DependencyGroup<Form>,
                       Alternative<Form>>(element, before);
}

#define DEBIAN_INSTANTIATE(Form)                                                                   \
    template std::string textOf<Form>(Package<Form> const&, Before, Missing);                      \
    template std::string textOf<Form>(Release<Form> const&, Before);                               \
    template std::string textOf<Form>(Alternative<Form> const&, Before, Missing);                  \
    template std::string textOf<Form>(DependencyGroup<Form> const&, Before, Missing);              \
    template std::string textOf<Form>(ModelElement const&, Before);
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
