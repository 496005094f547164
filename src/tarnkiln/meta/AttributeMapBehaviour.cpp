#include "tarnkiln/meta/AttributeMapAttributeImpl.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"

namespace tarn::kiln::meta {

namespace {

/// The qualified name of the class that `emplace` makes for `fqn`.
ustring attributeClassName(ustring const& fqn)
{
    ustring const name = fqn + u"Attribute";
    return name.find(u'.') == ustring::npos ? u"tarn.kiln.meta." + name : name;
}
}  // namespace

ModelElement AttributeMap::Impl::getOwner() const
{
    return container();
}

void AttributeMap::Impl::insert(Attribute const& attribute)
{
    getAttributes().insert(attribute);
}

void AttributeMap::Impl::insertOrReplace(Attribute const& attribute)
{
    if (!attribute)
        return;
    Attribute const present = at(attribute->getKey());
    if (present && present != attribute && !attribute->isProxy())
    {
        // Nothing may be destroyed for an attribute that can not come in.
        checkCompatibleModel(attribute.getImpl(), ATTRIBUTES);
        present->destroy();
    }
    insert(attribute);
}

Attribute AttributeMap::Impl::emplace(ustring const& fqn, ustring const& key)
{
    Class const metaClass = MetaRegistry::getInstance().getClass(attributeClassName(fqn));
    ModelElement const made =
        metaClass ? metaClass->instantiate(getModel(), UUID()) : ModelElement();
    Attribute const attribute = Attribute::cast(made);
    if (!attribute)
    {
        if (made)
            made->destroy();
        return Attribute();
    }
    try
    {
        attribute->setKey(key);
        insert(attribute);
    }
    catch (...)
    {
        attribute->destroy();
        throw;
    }
    return attribute;
}

Attribute AttributeMap::Impl::at(ustring const& key) const
{
    return getAttributes().find(key);
}

Attribute AttributeMap::Impl::recursiveAt(std::vector<ustring> const& keys) const
{
    return doRecurse(keys, 0, static_cast<int>(keys.size()));
}

void AttributeMap::Impl::eraseValue(Attribute const& attribute)
{
    getAttributes().erase(attribute);
}

void AttributeMap::Impl::erase(ustring const& key)
{
    getAttributes().erase(at(key));
}

void AttributeMap::Impl::removeValue(Attribute const& attribute)
{
    if (!getAttributes().contains(attribute))
        return;
    ustring const key = attribute->getKey();
    remove(key);
}

void AttributeMap::Impl::remove(ustring const& key)
{
    if (Attribute const present = at(key))
        present->destroy();
}

Attribute AttributeMap::Impl::doRecurse(std::vector<ustring> const& keys, int index, int size) const
{
    // Reflection lets any numbers through.
    bool const isInside = index >= 0 && static_cast<std::size_t>(index) < keys.size();
    if (index >= size || !isInside)
        return Attribute();
    Attribute const found = at(keys[static_cast<std::size_t>(index)]);
    if (index + 1 == size)
        return found;

    AttributeMapAttribute const branch = AttributeMapAttribute::cast(found);
    AttributeMap const inner = branch ? branch->getValue() : AttributeMap();
    return inner ? inner->doRecurse(keys, index + 1, size) : Attribute();
}
}  // namespace tarn::kiln::meta
