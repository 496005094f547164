/// \file
/// The handle of a model.
#pragma once
#include "tarnkiln/kernel/ElementHandle.h"

namespace tarn::kiln {

/// A root container of elements, with their registry, transactions and listeners.
///
///     Model model = Model::create(ModelConstellation());
///     Transaction transaction = model->beginTransaction(/*revertible=*/true);
///     Book book = Book::create(model);
///     book->setTitle(u"Emma");
///     transaction.commit();
///
/// A model lives as long as its constellation, and that as long as any handle to it or to one of
/// its models; registry and transient models live as long as their handles.
///
/// Threads: a model with its elements, transactions and listeners belongs to one thread at a time.
class TARNKILN_EXPORT Model : public ElementHandle
{
public:
    class Impl;                                  // ModelImpl.h
    class Freezer;                               // Freezer.h
    class Thawer;                                // Freezer.h
    class ParseInProgressIndicator;              // ProgressIndicators.h
    class DataSourceLoadingInProgressIndicator;  // ProgressIndicators.h

    Model() = default;
    explicit Model(Impl* impl);

    /// A new model in `constellation`, or in a new one if that is empty or dead.
    ///
    /// \throws tarnkiln::messages::CannotJoinShallowTransaction  if a shallow group is open there.
    static Model create(ModelConstellation const& constellation);
    static Model create(UUID const& id, ModelConstellation const& constellation);
    /// A model outside all constellations, which may be referred to but refers to nothing.
    static Model createRegistryModel(ustring const& uri, UUID const& id = {});
    /// A model outside all constellations, without a URI.
    static Model createTransientModel(UUID const& id = {});

    /// The class by which values that hold models are typed.
    static meta::Class const& metaClass();
    /// Creates that class; called once, when the registry starts.
    static void initializeType(meta::MetaRegistry& registry);

    Impl* getImpl() const;
    Impl* operator->() const;  ///< All operations of the model; the handle must not be empty.
};
}  // namespace tarn::kiln
