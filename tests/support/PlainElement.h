/// \file
/// An element class written on the bare kernel, with plain vectors for collections.
///
/// It needs neither generated code nor a metamodel: its properties are slots and its metaclass is
/// empty. It counts its instances, tells a trace what it is asked to do, and lets tests break it.
#pragma once
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"

#include <functional>
#include <string>
#include <vector>

namespace testkit {

using namespace tarn::kiln;

class Plain : public ModelElement
{
public:
    class Impl;
    class Builder;

    Plain() = default;
    explicit Plain(Impl* impl);

    static Plain cast(ModelElement const& element);
    static Plain create(Model const& model, UUID const& id = {});
    static Plain createProxy(Model const& model, ProxyId const& id);

    Impl* getImpl() const;
    Impl* operator->() const;
};

class Plain::Impl : public ModelElement::Impl
{
public:
    using ModelElement::Impl::Storage;
    class Record;

    enum Index : unsigned long
    {
        VALUE = 1,
        CHILDREN,   ///< Many, composite, opposite `PARENT`.
        PARENT,     ///< The container reference.
        PARTS,      ///< Many, composite, no opposite.
        PEER,       ///< Single, opposite to itself.
        LINKS,      ///< Many, opposite `BACKLINKS`.
        BACKLINKS,  ///< Many, opposite `LINKS`.
        LOOK,       ///< Single, no opposite.
        SLOTS
    };
    static Slot const CHILDREN_SLOT;
    static Slot const PARENT_SLOT;
    static Slot const PARTS_SLOT;
    static Slot const PEER_SLOT;
    static Slot const LINKS_SLOT;
    static Slot const BACKLINKS_SLOT;
    static Slot const LOOK_SLOT;

    /// What all properties hold.
    struct Fields
    {
        int value = 0;
        std::vector<ModelElement> children;
        std::vector<ModelElement> parts;
        std::vector<ModelElement> links;
        std::vector<ModelElement> backlinks;
        ModelElement peer;
        ModelElement look;
    };

    Impl(Model const& model, UUID const& id);
    Impl(ModelElement::Builder& builder, UUID const& id);
    ~Impl() override;

    /// How many there are in memory, live or not.
    static long inMemory;
    /// What elements were asked to do, as "step name"; null for no trace.
    static std::vector<std::string>* trace;
    /// Runs in `didCreate` and `aboutToDestroy`.
    static std::function<void(Impl&)> whenCreated;
    static std::function<void(Impl&)> whenAboutToDestroy;

    int getValue() const { return fields.value; }
    void setValue(int value);
    void addChild(Plain const& child);
    void removeChild(Plain const& child);
    void setParent(Plain const& parent);
    void addPart(Plain const& part);
    void setPeer(Plain const& peer);
    void setLook(ModelElement const& target);
    void addLink(Plain const& target);
    Plain getParent() const { return Plain::cast(container()); }
    /// The target, which takes the place of a proxy for it.
    ModelElement getPeer();

    // ElementImpl
    meta::Class const& getMetaClass() const override;
    void invalidate() override;

    // ModelElement::Impl
    void doDestroy(bool keepIncoming, bool multiModel) override;
    void notifyDestroying() override;
    void disassociateIncoming() override;
    void convertReferencesToProxies(bool multiModel, boost::optional<ProxyId>& cachedId) override;
    void aboutToDestroy() override;
    void didCreate() override;
    void basicDisassociateAll() override;
    Changes* createChanges() const override;
    Storage* createStorage() const override;
    void copyValue(Storage* storage, unsigned long index) const override;
    void copyStateFromStorage(Storage* storage) override;
    void inverseAddSlot(ModelElement const& element, Slot const& slot) override;
    void inverseRemoveSlot(ModelElement const& element, Slot const& slot) override;
    void convertToProxySlot(Slot const& slot, ProxyId const& id,
                            ModelElement const& element) override;
    ModelElement::Impl* basicGetReference(Slot const& slot) const override;
    void visitReferences(ReferenceVisitor const& visit) const override;

    Fields fields;     ///< Open to tests, which may break what must hold.
    std::string name;  ///< For the trace.
    static bool tracesModifications;

private:
    std::vector<ModelElement>& many(unsigned long index);
    void tell(char const* step) const;
    void modify(unsigned long index);
    void removeFrom(unsigned long index, ModelElement const& element);
};

/// The old values.
class Plain::Impl::Record : public ModelElement::Impl::Storage
{
public:
    using Storage::Storage;

    Fields old;
};

/// Builds a tree of elements.
class Plain::Builder : public ModelElement::Builder
{
public:
    explicit Builder(Model const& model);
    /// For a builder that becomes a child of another.
    Builder();

    meta::Class const& getMetaClass() const override;
    Builder& setValue(int value);
    Builder& addChild(std::unique_ptr<Builder> child);
    bool isValueSet() const { return m_setProperties.test(Impl::VALUE); }

    /// Runs after the element has been made and before it is announced.
    std::function<void(Plain const&)> beforeCreated;

protected:
    ModelElement doCreate(bool proxy, UUID const& id) override;

private:
    Plain make(Orchestrator& orchestrator, UUID const& id);

    int m_value = 0;
    std::vector<std::unique_ptr<Builder>> m_children;
};

inline Plain::Impl* Plain::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Plain::Impl* Plain::operator->() const
{
    return static_cast<Impl*>(m_impl);
}

/// A chain of elements below `root`, each a part of the one before; returns the last.
Plain addChain(Plain const& root, int length);

/// Expects that at its end as many elements are in memory as at its beginning.
class ExpectNoLeakedElements
{
public:
    ExpectNoLeakedElements();
    ~ExpectNoLeakedElements();

private:
    long m_before = Plain::Impl::inMemory;
};
}  // namespace testkit
