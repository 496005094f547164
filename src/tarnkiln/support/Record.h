/// \file
/// The change record of a class with a table of rows.
#pragma once
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/support/Rows.h"

namespace tarn::kiln::support {

/// The values that an element of the class `Owner` had when the transaction began.
///
/// It adds no fields: the base keeps the values of the slots that changed, and the rows know their
/// types. Reports may keep it alive longer. `Base` is the record of the superclass.
template <class Owner, class Base> class TARNKILN_EXPORT Record : public Base
{
public:
    using Base::Base;
    ~Record() override;

    bool revertUnchanged(ModelElement::Impl* element) override;
    Value getOldValue(meta::Property const& property,
                      internal::ReflectionPrivateTag const& tag) const override;
};
}  // namespace tarn::kiln::support
