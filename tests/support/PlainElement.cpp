#include "tests/support/PlainElement.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/Class.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace testkit {

namespace {

void eraseFirst(std::vector<ModelElement>& elements, ModelElement const& element)
{
    auto const found = std::find(elements.begin(), elements.end(), element);
    if (found != elements.end())
        elements.erase(found);
}

}  // namespace

Slot const Plain::Impl::CHILDREN_SLOT{CHILDREN, /*composite=*/true, /*single=*/false, false,
                                      &Impl::PARENT_SLOT};
Slot const Plain::Impl::PARENT_SLOT{PARENT, /*composite=*/false, /*single=*/true, false,
                                    &Impl::CHILDREN_SLOT};
Slot const Plain::Impl::PARTS_SLOT{PARTS, /*composite=*/true, /*single=*/false};
Slot const Plain::Impl::PEER_SLOT{PEER, /*composite=*/false, /*single=*/true, false,
                                  &Impl::PEER_SLOT};
Slot const Plain::Impl::LINKS_SLOT{LINKS, /*composite=*/false, /*single=*/false, false,
                                   &Impl::BACKLINKS_SLOT};
Slot const Plain::Impl::BACKLINKS_SLOT{BACKLINKS, /*composite=*/false, /*single=*/false, false,
                                       &Impl::LINKS_SLOT};
Slot const Plain::Impl::LOOK_SLOT{LOOK, /*composite=*/false, /*single=*/true};

long Plain::Impl::inMemory = 0;
std::vector<std::string>* Plain::Impl::trace = nullptr;
bool Plain::Impl::tracesModifications = false;
std::function<void(Plain::Impl&)> Plain::Impl::whenCreated;
std::function<void(Plain::Impl&)> Plain::Impl::whenAboutToDestroy;

Plain::Plain(Impl* impl) : ModelElement(impl) {}

Plain Plain::cast(ModelElement const& element)
{
    return Plain(dynamic_cast<Impl*>(element.getImpl()));
}

Plain Plain::create(Model const& model, UUID const& id)
{
    Plain const result(new Impl(model, id));
    result->notifyCreated();
    return result;
}

Plain Plain::createProxy(Model const& model, ProxyId const& id)
{
    return cast(Builder(model).createProxy(id));
}

// ---------------------------------------------------------------------------- life

Plain::Impl::Impl(Model const& model, UUID const& id) : ModelElement::Impl(model, id)
{
    ++inMemory;
}

Plain::Impl::Impl(ModelElement::Builder& builder, UUID const& id) : ModelElement::Impl(builder, id)
{
    ++inMemory;
}

Plain::Impl::~Impl()
{
    --inMemory;
}

void Plain::Impl::tell(char const* step) const
{
    if (trace)
        trace->push_back(std::string(step) + ' ' + name);
}

meta::Class const& Plain::Impl::getMetaClass() const
{
    static meta::Class const none;
    return none;
}

void Plain::Impl::didCreate()
{
    tell("didCreate");
    if (whenCreated)
        whenCreated(*this);
}

void Plain::Impl::aboutToDestroy()
{
    tell("aboutToDestroy");
    if (whenAboutToDestroy)
        whenAboutToDestroy(*this);
}

void Plain::Impl::notifyDestroying()
{
    tell("notifyDestroying");
    ModelElement::Impl::notifyDestroying();
}

void Plain::Impl::invalidate()
{
    tell("invalidate");
    ModelElement::Impl::invalidate();
}

// ---------------------------------------------------------------------------- properties

std::vector<ModelElement>& Plain::Impl::many(unsigned long index)
{
    switch (index)
    {
    case CHILDREN:
        return fields.children;
    case PARTS:
        return fields.parts;
    case LINKS:
        return fields.links;
    default:
        return fields.backlinks;
    }
}

void Plain::Impl::modify(unsigned long index)
{
    if (tracesModifications)
        tell(("modify " + std::to_string(index)).c_str());
    notifyModifying(index);
}

void Plain::Impl::setValue(int value)
{
    if (isProxy())
        reportException(tarnkiln::messages::CannotModifyProxy());
    if (value == fields.value)
        return;
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(VALUE);
    fields.value = value;
    transaction.commit();
}

void Plain::Impl::addChild(Plain const& child)
{
    checkCompatibleModel(child.getImpl(), CHILDREN_SLOT);
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(CHILDREN);
    fields.children.push_back(child);
    _inverseAddThis(child.getImpl(), PARENT_SLOT, /*force=*/false);
    transaction.commit();
}

void Plain::Impl::removeChild(Plain const& child)
{
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(CHILDREN);
    _inverseRemoveThis(child.getImpl(), PARENT_SLOT);
    eraseFirst(fields.children, child);
    transaction.commit();
}

void Plain::Impl::setParent(Plain const& parent)
{
    ModelElement const keep(this);
    checkCompatibleModel(parent.getImpl(), PARENT_SLOT);
    if (parent)
        parent->checkCompatibleModel(this, CHILDREN_SLOT);
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(PARENT);
    makeUncontained();
    if (parent)
    {
        basicSetContainer(parent.getImpl(), CHILDREN_SLOT, NO_INDEX);
        _inverseAddThis(parent.getImpl(), CHILDREN_SLOT, /*force=*/true);
    }
    transaction.commit();
}

void Plain::Impl::addPart(Plain const& part)
{
    checkCompatibleModel(part.getImpl(), PARTS_SLOT);
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(PARTS);
    fields.parts.push_back(part);
    _setContainedByThis(part.getImpl(), PARTS_SLOT);
    transaction.commit();
}

void Plain::Impl::setPeer(Plain const& peer)
{
    checkCompatibleModel(peer.getImpl(), PEER_SLOT);
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(PEER);
    ModelElement const old = fields.peer;
    if (old)
        _inverseRemoveThis(old.getImpl(), PEER_SLOT);
    fields.peer = peer;
    if (peer)
        _inverseAddThis(peer.getImpl(), PEER_SLOT, /*force=*/false);
    transaction.commit();
}

void Plain::Impl::setLook(ModelElement const& target)
{
    checkCompatibleModel(target.getImpl(), LOOK_SLOT);
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(LOOK);
    fields.look = target;
    transaction.commit();
}

void Plain::Impl::addLink(Plain const& target)
{
    checkCompatibleModel(target.getImpl(), LINKS_SLOT);
    Transaction const transaction = getModel()->beginTransaction(/*revertible=*/false);
    modify(LINKS);
    fields.links.push_back(target);
    _inverseAddThis(target.getImpl(), BACKLINKS_SLOT, /*force=*/false);
    transaction.commit();
}

ModelElement Plain::Impl::getPeer()
{
    if (fields.peer && fields.peer->isProxy())
        fields.peer = getModel()->resolveProxy(this, fields.peer);
    return fields.peer;
}

// ---------------------------------------------------------------------------- other ends

void Plain::Impl::inverseAddSlot(ModelElement const& element, Slot const& slot)
{
    modify(slot.index);
    switch (slot.index)
    {
    case PARENT: {
        ModelElement const keep(this);
        makeUncontained();
        basicSetContainer(element.getImpl(), CHILDREN_SLOT, NO_INDEX);
        break;
    }
    case PEER:
        if (fields.peer)
            _inverseRemoveThis(fields.peer.getImpl(), PEER_SLOT);
        fields.peer = element;
        break;
    default:
        many(slot.index).push_back(element);
    }
}

void Plain::Impl::inverseRemoveSlot(ModelElement const& element, Slot const& slot)
{
    modify(slot.index);
    switch (slot.index)
    {
    case PARENT:
        basicSetContainer(nullptr, Feature(), NO_INDEX);
        break;
    case PEER:
        fields.peer = ModelElement();
        break;
    default:
        eraseFirst(many(slot.index), element);
    }
}

void Plain::Impl::convertToProxySlot(Slot const& slot, ProxyId const& id,
                                     ModelElement const& element)
{
    Plain const proxy = createProxy(getModel(), id);
    if (slot.index == PEER)
        fields.peer = proxy;
    else
        std::replace(many(slot.index).begin(), many(slot.index).end(), element,
                     static_cast<ModelElement>(proxy));
}

ModelElement::Impl* Plain::Impl::basicGetReference(Slot const& slot) const
{
    return slot.index == PEER   ? fields.peer.getImpl()
           : slot.index == LOOK ? fields.look.getImpl()
                                : nullptr;
}

void Plain::Impl::visitReferences(ReferenceVisitor const& visit) const
{
    for (ModelElement const& element : fields.children)
        visit(element, CHILDREN_SLOT);
    for (ModelElement const& element : fields.parts)
        visit(element, PARTS_SLOT);
    for (ModelElement const& element : fields.links)
        visit(element, LINKS_SLOT);
    for (ModelElement const& element : fields.backlinks)
        visit(element, BACKLINKS_SLOT);
    visit(fields.peer, PEER_SLOT);
    visit(fields.look, LOOK_SLOT);
}

// ---------------------------------------------------------------------------- destruction

void Plain::Impl::removeFrom(unsigned long index, ModelElement const& element)
{
    if (index == PEER)
        _inverseRemoveThis(element.getImpl(), PEER_SLOT);
    else
        _inverseRemoveThis(element.getImpl(), index == LINKS ? BACKLINKS_SLOT : LINKS_SLOT);
}

void Plain::Impl::disassociateIncoming()
{
    tell("disassociateIncoming");
    for (unsigned long const index : {LINKS, BACKLINKS})
    {
        modify(index);
        for (ModelElement const& element : std::exchange(many(index), {}))
            removeFrom(index, element);
    }
    modify(PEER);
    if (ModelElement const old = std::exchange(fields.peer, {}))
        removeFrom(PEER, old);
    modify(LOOK);
    fields.look = ModelElement();
}

void Plain::Impl::doDestroy(bool keepIncoming, bool multiModel)
{
    tell(keepIncoming ? "doDestroy-keeping" : "doDestroy");
    for (unsigned long const index : {CHILDREN, PARTS})
    {
        modify(index);
        for (ModelElement const& element : std::vector<ModelElement>(many(index)))
            element->destroyRecursively(keepIncoming, /*removeFromContainer=*/false, multiModel);
        many(index).clear();
    }
}

void Plain::Impl::convertReferencesToProxies(bool multiModel, boost::optional<ProxyId>& cachedId)
{
    tell(multiModel ? "convertReferencesToProxies-multi" : "convertReferencesToProxies");
    auto const convert = [&](ModelElement const& target, Slot const& opposite) {
        if (!multiModel || !target || target->isProxy() || target->getModelImpl() == getModelImpl())
            return;
        if (!cachedId)
            cachedId = _getPersistentProxyId();
        _convertToProxy(target.getImpl(), opposite, *cachedId);
    };
    for (ModelElement const& target : fields.links)
        convert(target, BACKLINKS_SLOT);
    for (ModelElement const& target : fields.backlinks)
        convert(target, LINKS_SLOT);
    convert(fields.peer, PEER_SLOT);
    fields.links.clear();
    fields.backlinks.clear();
    fields.peer = ModelElement();
    fields.look = ModelElement();
}

void Plain::Impl::basicDisassociateAll()
{
    tell("basicDisassociateAll");
    int const value = fields.value;
    Fields const dropped = std::exchange(fields, Fields());
    fields.value = value;
}

// ---------------------------------------------------------------------------- records

ModelElement::Impl::Changes* Plain::Impl::createChanges() const
{
    return new Changes(getUuid(), getModel(), getMetaClass(), SLOTS);
}

ModelElement::Impl::Storage* Plain::Impl::createStorage() const
{
    return new Record(getUuid(), getModel(), getMetaClass(), SLOTS);
}

void Plain::Impl::copyValue(Storage* storage, unsigned long index) const
{
    Fields& old = static_cast<Record*>(storage)->old;
    switch (index)
    {
    case VALUE:
        old.value = fields.value;
        break;
    case CHILDREN:
        old.children = fields.children;
        break;
    case PARENT:
        break;
    case PARTS:
        old.parts = fields.parts;
        break;
    case PEER:
        old.peer = fields.peer;
        break;
    case LINKS:
        old.links = fields.links;
        break;
    case BACKLINKS:
        old.backlinks = fields.backlinks;
        break;
    case LOOK:
        old.look = fields.look;
        break;
    default:
        ModelElement::Impl::copyValue(storage, index);
    }
}

void Plain::Impl::copyStateFromStorage(Storage* storage)
{
    tell("copyStateFromStorage");
    Fields& old = static_cast<Record*>(storage)->old;
    if (storage->isSlotChanged(VALUE))
        fields.value = old.value;
    if (storage->isSlotChanged(CHILDREN))
        fields.children = old.children;
    if (storage->isSlotChanged(PARTS))
        fields.parts = old.parts;
    if (storage->isSlotChanged(PEER))
        fields.peer = old.peer;
    if (storage->isSlotChanged(LINKS))
        fields.links = old.links;
    if (storage->isSlotChanged(BACKLINKS))
        fields.backlinks = old.backlinks;
    if (storage->isSlotChanged(LOOK))
        fields.look = old.look;
    ModelElement::Impl::copyStateFromStorage(storage);
}

// ---------------------------------------------------------------------------- builder

Plain::Builder::Builder(Model const& model) : ModelElement::Builder(model, Impl::SLOTS) {}

Plain::Builder::Builder() : ModelElement::Builder(Impl::SLOTS) {}

meta::Class const& Plain::Builder::getMetaClass() const
{
    static meta::Class const none;
    return none;
}

Plain::Builder& Plain::Builder::setValue(int value)
{
    m_value = value;
    m_setProperties.set(Impl::VALUE);
    return *this;
}

Plain::Builder& Plain::Builder::addChild(std::unique_ptr<Builder> child)
{
    m_children.push_back(std::move(child));
    return *this;
}

ModelElement Plain::Builder::doCreate(bool proxy, UUID const& id)
{
    if (proxy)
        return Plain(new Impl(*this, id));
    Orchestrator orchestrator(this);
    Plain const result = make(orchestrator, id);
    orchestrator.commit();
    return result;
}

Plain Plain::Builder::make(Orchestrator& orchestrator, UUID const& id)
{
    Plain const result(new Impl(*this, id));
    result->fields.value = m_value;
    if (beforeCreated)
        beforeCreated(result);
    result->notifyCreated();
    for (std::unique_ptr<Builder> const& child : m_children)
    {
        orchestrator.addBuilder(child.get());
        result->addChild(child->make(orchestrator, UUID{}));
    }
    return result;
}

Plain addChain(Plain const& root, int length)
{
    Plain last = root;
    for (int i = 0; i < length; ++i)
    {
        // past the search for circles, whose time grows with the depth
        Plain const next = Plain::create(root->getModel());
        last->fields.parts.push_back(next);
        last->_setContainedByThis(next.getImpl(), Plain::Impl::PARTS_SLOT);
        last = next;
    }
    return last;
}

// ---------------------------------------------------------------------------- leaks

ExpectNoLeakedElements::ExpectNoLeakedElements() = default;

ExpectNoLeakedElements::~ExpectNoLeakedElements()
{
    EXPECT_EQ(Plain::Impl::inMemory, m_before) << "elements stayed in memory, or went too early";
}
}  // namespace testkit
