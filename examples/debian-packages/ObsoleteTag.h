/// \file
/// A mark on packages that their class knows nothing of.
#pragma once
#include "Forms.h"
#include "Table.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/meta/Extension.h"

#include <cstddef>
#include <string>

namespace debian {

/// An extension of class `Package` in one model, as long as this object lives: a `Boolean` that is
/// false by default.
///
/// Must not be made or destroyed while a transaction of the registry is open.
///
/// Threads: as the model.
template <ElementForm Form> class ObsoleteTag
{
public:
    static constexpr char16_t const* NAME = u"isObsolete";

    /// \throws tarnkiln::messages::ExtensionNameMustBeUnique  if the model has one already.
    explicit ObsoleteTag(tarn::kiln::Model const& model);
    ~ObsoleteTag();
    ObsoleteTag(ObsoleteTag const&) = delete;
    ObsoleteTag& operator=(ObsoleteTag const&) = delete;

    /// Tags the packages whose names match, and returns their number. Must be called in an open
    /// transaction.
    ///
    /// \param pattern  a regular expression that is searched in the names.
    /// \throws std::runtime_error  if it is no regular expression; nothing is tagged then.
    std::size_t setOnMatching(std::string const& pattern) const;

    /// The packages that have the tag, as a query finds them: name, number of releases.
    Table packagesWithTag() const;

private:
    tarn::kiln::Model m_model;
    tarn::kiln::meta::Extension m_tag;
};

}  // namespace debian
