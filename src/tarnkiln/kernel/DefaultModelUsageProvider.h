/// \file
/// The usage provider that a model starts with.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DataModelUsageProvider.h"

#include <unordered_map>
#include <utility>

namespace tarn::kiln {

/// Counts elements: a package is in use while an element of one of its classes, or of a class
/// derived from one, exists.
///
/// Counts follow creation and destruction only. Undoing either leaves them as they are.
class TARNKILN_EXPORT DefaultModelUsageProvider final : public meta::DataModelUsageProvider
{
public:
    std::vector<meta::Package> getUsedPackages() const override;
    void elementCreated(ModelElement::Impl* element) override;
    void elementDestroying(ModelElement::Impl* element) override;
    void clear() override;

private:
    void count(ModelElement::Impl const& element, long step);

    /// Elements by class; packages are only looked for when they are asked for.
    std::unordered_map<meta::Class, long, std::hash<ModelElement>> m_elements;
    std::pair<meta::Class const, long>* m_last = nullptr;  ///< The entry that was changed last.
};
}  // namespace tarn::kiln
