#include "tarnkiln/services/datasource/DataSource.h"

#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ElementId.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/uuidText.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/services/datasource/LoadingTransaction.h"

namespace tarn::kiln::datasource {
namespace {

/// Calls `visit` for each stored property of `metaClass` and its superclasses that refers to
/// elements and is composite, or not, as `composite` says.
template <class Visitor>
void visitReferences(meta::Class const& metaClass, bool composite, Visitor const& visit)
{
    for (meta::Class current = metaClass; current; current = current->getSuperclass())
    {
        for (auto const& [name, property] : current->getOwnedAttributes())
        {
            meta::Class const target = meta::Class::cast(property->getType());
            bool const isReference = target && target->getMetaClass() == meta::Class::metaClass();
            if (isReference && !property->isDerived() && property->isComposite() == composite)
                visit(property);
        }
    }
}

Value read(ModelElement const& element, meta::Property const& property)
{
    return element->getPropertyValue(property, ModelElement::Impl::PRIVILEGED_ACCESS);
}
}  // namespace

ModelElement::Impl::ReflectionPrivateTag const& DataSource::privilegedTag =
    ModelElement::Impl::NO_PROXY_RESOLVE;
ModelElement::Impl::ReflectionPrivateTag const& DataSource::privilegedTagWithResolve =
    ModelElement::Impl::PRIVILEGED_ACCESS;

DataSource::DataSource(Model::Impl* model) : m_model(model) {}

DataSource::~DataSource() = default;

ModelElement DataSource::fetchElement(UUID const& id)
{
    return lookupElement(ModelElement::metaClass(),
                         ElementId(ElementId::UUID_TYPE, internal::uuidText(id)));
}

void DataSource::loadElementSubtree(ModelElement const& element)
{
    meta::Class const metaClass = element->getMetaClass();

    visitReferences(metaClass, /*composite=*/false, [&](meta::Property const& property) {
        Value const value = read(element, property);
        if (property->getUpper() > 1)
            value.getValue<ReferenceCollection&>().resolveLocal();
    });

    visitReferences(metaClass, /*composite=*/true, [&](meta::Property const& property) {
        Value const value = read(element, property);
        if (property->getUpper() > 1)
        {
            for (ModelElement const& child : value.getValue<ReferenceCollection&>().getAllValues())
                loadElementSubtree(child);
        }
        else if (ModelElement const child = value.getValue<ModelElement>())
        {
            loadElementSubtree(child);
        }
    });
}

LoadingTransaction DataSource::beginLoadingTransaction()
{
    return LoadingTransaction(m_model);
}

void DataSource::doBasicAddWithProxy(ReferenceCollection& collection, ModelElement& element)
{
    collection.basicAddWithProxy(element);
}

void DataSource::doSetContained(ModelElement const& child, ModelElement const& owner,
                                meta::Property const& property)
{
    child->basicSetContainer(owner.getImpl(), property, ModelElement::Impl::NO_INDEX);
}
}  // namespace tarn::kiln::datasource
