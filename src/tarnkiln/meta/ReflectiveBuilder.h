/// \file
/// Builds elements of a class that is known at run time only.
#pragma once
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"

#include <memory>
#include <vector>

namespace tarn::kiln {

/// Collects values and gives them to a new reflective element, in the order in which they came.
///
/// The registry makes it for classes that `PackageDefinition` defines.
///
/// Threads: as all builders.
class TARNKILN_EXPORT ReflectiveBuilder final : public ModelElement::Builder
{
public:
    ReflectiveBuilder(Model const& model, meta::Class const& metaClass);
    /// For a nested builder.
    explicit ReflectiveBuilder(meta::Class const& metaClass);

    // ModelElement::Builder
    meta::Class const& getMetaClass() const override { return m_metaClass; }
    /// A plain value or an element. One of a wrong type for a many-valued property is refused when
    /// the element is built.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (property, class) if the class has no such
    ///     stored property.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes, InvalidValue  if it does not suit a
    ///     single property: see `Value::checkCompatibleWithProperty`.
    void setOrAdd(meta::Property const& property, Value const& value) override;
    /// The builder of what a composite property is to hold.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (property, class) if the class has no such
    ///     composite property, or the builder is null or makes elements of another class.
    void setOrAdd(meta::Property const& property, std::unique_ptr<Builder> value) override;

protected:
    // ModelElement::Builder
    ModelElement doCreate(bool proxy, UUID const& id) override;

private:
    /// A value, or a builder of one.
    struct Given
    {
        meta::Property property;
        Value value;
        std::unique_ptr<Builder> nested;
    };

    bool isStored(meta::Property const& property) const;
    void give(Given given);
    void checkConcrete() const;
    ModelElement construct(UUID const& id) const;
    ModelElement build(UUID const& id);
    Value valueOf(Given const& given);

    meta::Class const m_metaClass;
    std::vector<Given> m_given;
};
}  // namespace tarn::kiln
