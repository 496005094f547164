/// \file
/// Verifies what must hold in a model between any two operations.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"

#include <unordered_set>
#include <vector>

namespace tarn::kiln::internal {

/// Looks at one model and collects a sentence for each violation. Resolves, loads and makes
/// nothing.
///
/// | Structure | What must hold |
/// |---|---|
/// | registry | entries are valid, of this model, no proxies, and stand under their own UUIDs |
/// | top level | exactly the elements without a link stand in the set |
/// | containment | a link and the composite reference that holds the element agree; no cycles |
/// | opposites | a reference between two elements of the model is answered by the other end |
/// | extensions | values differ from the default, collections are of their element and extension, |
/// |            | and both are of live extensions of this model, as far as these live |
class InvariantChecker
{
public:
    explicit InvariantChecker(Model::Impl const& model) : m_model(model) {}

    std::vector<string> run();

private:
    struct Reference
    {
        ModelElement::Impl const* source;
        ModelElement::Impl const* target;
        Feature feature;
    };

    void checkElement(ModelElement::Impl const& element);
    void collectReferences(ModelElement::Impl const& element);
    void checkReference(Reference const& reference);
    void checkContainer(ModelElement::Impl const& element);
    void checkCycles();
    void checkDeclaredExtensions();
    void checkExtensionValues(ModelElement::Impl const& element);
    bool isHere(ModelElement::Impl const& element) const;
    bool refersBack(Reference const& reference) const;
    void report(string const& sentence, ModelElement::Impl const& element);

    Model::Impl const& m_model;
    std::vector<string> m_violations;
    std::vector<Reference> m_references;  ///< Sorted by source, target.
};
}  // namespace tarn::kiln::internal
