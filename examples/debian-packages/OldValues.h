/// \file
/// The values before a transaction, as its report tells them.
#pragma once
#include "tarnkiln/kernel/ReportData.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"

#include <vector>

namespace debian {

/// The properties of the class and of all that it extends.
std::vector<tarn::kiln::meta::Property> propertiesOf(tarn::kiln::meta::Class const& metaClass);

/// The property of that name that the class of `element` has itself.
tarn::kiln::meta::Property propertyOf(tarn::kiln::ModelElement const& element,
                                      tarn::kiln::ustring const& name);

bool isReference(tarn::kiln::meta::Property const& property);  ///< Whether its values are elements.
bool isMany(tarn::kiln::meta::Property const& property);       ///< Whether it has many values.
/// Whether it refers to the element that contains this one.
bool isContainer(tarn::kiln::meta::Property const& property);

/// What a many-valued reference of a changed or destroyed element held, in its order, dead
/// elements and proxies included.
std::vector<tarn::kiln::ModelElement> oldMembers(tarn::kiln::ReportData const& report,
                                                 tarn::kiln::ModelElement const& element,
                                                 tarn::kiln::meta::Property const& property);

/// What a single reference of a changed or destroyed element held; empty if nothing.
tarn::kiln::ModelElement oldTarget(tarn::kiln::ReportData const& report,
                                   tarn::kiln::ModelElement const& element,
                                   tarn::kiln::meta::Property const& property);

}  // namespace debian
