/// \file
/// How an element is built together with what it contains, in one transaction.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/support/OpenStep.h"
#include "tarnkiln/support/SlotSet.h"

#include <map>
#include <memory>

namespace tarn::kiln {

/// Collects the values of a new element. Each class derives its own.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT ModelElement::Builder
{
public:
    class Orchestrator;

    Builder(Builder const&) = delete;
    Builder& operator=(Builder const&) = delete;
    virtual ~Builder();

    virtual meta::Class const& getMetaClass() const = 0;
    /// Sets a single-valued property, or adds to a many-valued one.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (property, class) if the class has none such.
    virtual void setOrAdd(meta::Property const& property, Value const& value);
    virtual void setOrAdd(meta::Property const& property, std::unique_ptr<Builder> value);

    /// Builds the element; the nil UUID stands for a fresh one.
    ///
    /// \throws tarnkiln::messages::NoSuchOperation  ("create", class) if the class is abstract.
    /// \throws tarnkiln::messages::ModelFrozen  if the model is frozen.
    ModelElement create(UUID const& id = {});
    /// Builds a stand-in for the element that `id` names.
    ModelElement createProxy(ProxyId const& id);

    Model const& getModel() const { return m_model; }
    /// Whether the property at that slot was given; clearing a many-valued one counts.
    bool isSet(unsigned long index) const { return m_setProperties.test(index); }
    Orchestrator* getOrchestrator() const { return m_orchestrator; }

protected:
    /// \param bits  the number of slots of the class.
    Builder(Model const& model, unsigned long bits);
    /// For a nested builder, which takes the model of the orchestrator that it joins.
    explicit Builder(unsigned long bits);

    /// The last step of `create` and `createProxy`.
    virtual ModelElement doCreate(bool proxy, UUID const& id) = 0;

    support::SlotSet m_setProperties;

private:
    friend class ModelElement::Impl;

    Model m_model;
    Orchestrator* m_orchestrator = nullptr;
};

/// Creates a tree of builders in one revertible transaction; dropped uncommitted it takes all back.
class TARNKILN_EXPORT ModelElement::Builder::Orchestrator
{
public:
    /// Opens the transaction and takes `builder` in.
    ///
    /// \throws tarnkiln::messages::CannotCreateWithoutModel  if the builder has no model.
    /// \throws tarnkiln::messages::ModelFrozen  if the model is frozen; an outer transaction can
    ///     then only be rolled back.
    explicit Orchestrator(Builder* builder);
    Orchestrator(Orchestrator const&) = delete;
    Orchestrator& operator=(Orchestrator const&) = delete;
    ~Orchestrator();

    /// Takes a builder in, unless it has an orchestrator.
    void addBuilder(Builder* builder);
    void removeBuilder(Builder* builder);
    /// Told by the constructor of an element that is made from `builder`.
    void registerCreatedElement(Builder* builder, ModelElement::Impl* element);
    /// Takes that back, for what is no part of the creation.
    void forgetCreatedElement(Builder* builder);
    /// The element made from `builder`; empty before that.
    ModelElement getCreatedElement(Builder* builder) const;
    /// Commits and lets go of all builders.
    void commit();

    /// Tells this thread's orchestrators that an element that one of them was told of dies, because
    /// the constructor of a derived class has failed.
    static void constructionFailed(ModelElement::Impl const* element);

private:
    void releaseBuilders();

    Model m_model;
    Transaction m_transaction;
    support::OpenStep m_step;
    std::map<Builder*, ModelElement> m_created;
    Orchestrator* m_next = nullptr;  ///< Of those of this thread.
};
}  // namespace tarn::kiln
