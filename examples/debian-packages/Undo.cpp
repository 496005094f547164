#include "Undo.h"

#include "OldValues.h"
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <algorithm>
#include <stdexcept>

namespace debian {

using namespace tarn::kiln;

namespace {

auto const& ACCESS = ModelElement::Impl::NO_PROXY_RESOLVE;

/// The steps of `undo`, each over all elements before the next one.
class Undo
{
public:
    explicit Undo(ReportData const& report) : m_report(report), m_model(report.getModel()) {}

    void run() const
    {
        for (ModelElement const& element : m_report.getCreated())
            element->destroy();  // does nothing if its container took it along
        for (ModelElement const& element : m_report.getDestroyed())
            recreate(element);
        for (ModelElement const& element : m_report.getDestroyed())
        {
            for (meta::Property const& property : propertiesOf(element->getMetaClass()))
            {
                if (isReference(property))
                    restoreReference(element, property);
            }
        }
        for (ModelElement const& element : m_report.getChanged())
        {
            for (meta::Property const& property : m_report.getChangedProperties(element))
                restore(element, property);
        }
        redirectReferences();
    }

private:
    /// The element that stands for `element` now; itself if it is live, a proxy or in another
    /// model.
    ModelElement renewed(ModelElement const& element) const
    {
        bool const isGone = element.getImpl() && !element;
        return isGone ? m_model->findElement(element->getUuid()) : element;
    }

    /// Makes an element with the plain values of a destroyed one, which that one still has.
    void recreate(ModelElement const& destroyed) const
    {
        meta::Class const metaClass = destroyed->getMetaClass();
        ModelElement const made = metaClass->instantiate(m_model, destroyed->getUuid());
        for (meta::Property const& property : propertiesOf(metaClass))
        {
            if (!isReference(property))
                made->setPropertyValue(property, destroyed->getPropertyValue(property, ACCESS),
                                       ACCESS);
        }
    }

    void restore(ModelElement const& element, meta::Property const& property) const
    {
        if (isReference(property))
            restoreReference(element, property);
        else
            element->setPropertyValue(property, m_report.getOldValue(element, property), ACCESS);
    }

    /// Containers are left to the collections that contain, since those know the order.
    void restoreReference(ModelElement const& element, meta::Property const& property) const
    {
        if (isContainer(property))
            return;
        if (isMany(property))
            restoreMembers(element, property);
        else
            setTarget(renewed(element), property, oldTarget(m_report, element, property));
    }

    void setTarget(ModelElement const& element, meta::Property const& property,
                   ModelElement const& target) const
    {
        element->setPropertyValue(property, Value::createElementValue(property, renewed(target)),
                                  ACCESS);
    }

    void restoreMembers(ModelElement const& element, meta::Property const& property) const
    {
        std::vector<ModelElement> members = oldMembers(m_report, element, property);
        std::transform(members.begin(), members.end(), members.begin(),
                       [&](ModelElement const& member) { return renewed(member); });
        std::erase_if(members, [](ModelElement const& member) { return !member; });
        Value const value = renewed(element)->getPropertyValue(property, ACCESS);
        auto& collection = value.getValue<ReferenceCollection&>();
        GenericCollectionInterface& shown = *collection.getGenericInterface();
        for (ModelElement const& member : collection.getAllValuesAndProxies())
        {
            if (std::find(members.begin(), members.end(), member) == members.end())
                shown.genericRemove(member);
        }
        for (std::size_t place = 0; place < members.size(); ++place)
            ensureAt(shown, members[place], place);
    }

    /// All places before `place` are right already, so that only later members change theirs.
    static void ensureAt(GenericCollectionInterface& collection, ModelElement const& member,
                         std::size_t place)
    {
        if (!collection.isSequenceInterface())
            return collection.genericAdd(member);
        auto& sequence = static_cast<GenericSequenceInterface&>(collection);
        if (sequence.genericIndexOf(member) != static_cast<int>(place))
            sequence.genericEnsureAt(member, place);
    }

    /// References without another end stayed with what was destroyed.
    void redirectReferences() const
    {
        for (ModelElement const& element : m_model->getAllElements())
        {
            std::vector<std::pair<meta::Property, ModelElement>> stale;
            element->visitReferences([&](ModelElement const& target, Feature const& feature) {
                if (target.getImpl() && !target && feature.isSingle() && renewed(target))
                    stale.emplace_back(feature.property(), target);
            });
            for (auto const& [property, target] : stale)
                setTarget(element, property, target);
        }
    }

    ReportData const& m_report;
    Model const m_model;
};

}  // namespace

void undo(ReportData const& report)
{
    Transaction const transaction = report.getModel()->beginTransaction(/*revertible=*/true);
    Undo(report).run();
    if (transaction.commit() != TransactionResult::Committed)
        throw std::runtime_error("a listener of the model refused to take the changes back");
}

}  // namespace debian
