/// \file
/// The fields of the detached descriptions of extensions.
#pragma once
#include "tarnkiln/meta/DefaultDatatypeSerializer.h"
#include "tarnkiln/meta/ExtensionPrototype.h"

namespace tarn::kiln::meta {

/// Takes a `ExtensionPrototype` apart and puts it together.
class TARNKILN_EXPORT ExtensionPrototypeDatatypeSerializer final
    : public DefaultDatatypeSerializer<ExtensionPrototype>
{
public:
    /// \param type  the data type of the catalogue.
    explicit ExtensionPrototypeDatatypeSerializer(DataType const& type);
    ~ExtensionPrototypeDatatypeSerializer() override;
};
}  // namespace tarn::kiln::meta
