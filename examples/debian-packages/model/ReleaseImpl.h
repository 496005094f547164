/// \file
/// What stands behind a `Release`.
#pragma once
#include "model/DependencyGroup.h"
#include "model/Package.h"
#include "model/Release.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/support/Dispatch.h"
#include "tarnkiln/support/LazyCollection.h"

#include <boost/optional.hpp>

#include <memory>

namespace debian::model {

/// The properties of a `Release`, written the way generated classes are.
///
/// Setters work in the open transaction of the model, or in one of their own.
class Release::Impl : public support::Dispatched<Release::Impl, ModelElement::Impl>
{
public:
    using Handle = Release;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 12;
    static Slot const LABEL;
    static Slot const PACKAGE;
    static Slot const VERSION;
    static Slot const ARCHITECTURE;
    static Slot const SECTION;
    static Slot const MAINTAINER;
    static Slot const SUMMARY;
    static Slot const INSTALLED_SIZE;
    static Slot const ESSENTIAL;
    static Slot const GROUPS;
    static Slot const PROVIDES;

    Impl(Model const& model, UUID const& id);
    ~Impl() override;

    /// The key in the package: version, a blank and architecture.
    ustring const& getLabel() const { return m_label; }
    void setLabel(ustring const& label);

    /// The owner.
    Package getPackage() const;
    Package::Impl* getPackageImpl() const;
    void setPackage(Package const& package);

    /// In the syntax of Debian: epoch, upstream version, revision.
    ustring const& getVersion() const { return m_version; }
    void setVersion(ustring const& version);

    /// Such as "amd64", or "all".
    ustring const& getArchitecture() const { return m_architecture; }
    void setArchitecture(ustring const& architecture);

    /// Empty if the index does not tell.
    ustring const& getSection() const { return m_section; }
    void setSection(ustring const& section);

    /// Name and address; empty if the index does not tell.
    ustring const& getMaintainer() const { return m_maintainer; }
    void setMaintainer(ustring const& maintainer);

    /// The first line of the description.
    ustring const& getSummary() const { return m_summary; }
    void setSummary(ustring const& summary);

    /// In units of 1024 bytes; none if the index does not tell.
    boost::optional<long> const& getInstalledSize() const { return m_installedSize; }
    void setInstalledSize(boost::optional<long> const& installedSize);

    /// Whether the system can not do without it.
    bool isEssential() const { return m_essential; }
    void setIsEssential(bool essential);

    /// What it depends on; each group must be satisfied.
    ElementSequence<DependencyGroup>& getGroups() const;
    bool hasGroups() const { return m_groups.get(); }  ///< Whether the collection was made.

    /// The packages that it can stand in for.
    ElementSequence<Package>& getProvides() const;
    bool hasProvides() const { return m_provides.get(); }  ///< Whether the collection was made.

private:
    static std::unique_ptr<ElementSequence<DependencyGroup>> makeGroups(Impl* owner);
    static std::unique_ptr<ElementSequence<Package>> makeProvides(Impl* owner);

    ustring m_label;
    ustring m_version;
    ustring m_architecture;
    ustring m_section;
    ustring m_maintainer;
    ustring m_summary;
    boost::optional<long> m_installedSize;
    bool m_essential = false;
    mutable support::LazyCollection<ElementSequence<DependencyGroup>> m_groups;
    mutable support::LazyCollection<ElementSequence<Package>> m_provides;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_label, LABEL, &Impl::setLabel>,
        support::Container<Package, PACKAGE, &Impl::setPackage>,
        support::Scalar<&Impl::m_version, VERSION, &Impl::setVersion>,
        support::Scalar<&Impl::m_architecture, ARCHITECTURE, &Impl::setArchitecture>,
        support::Scalar<&Impl::m_section, SECTION, &Impl::setSection>,
        support::Scalar<&Impl::m_maintainer, MAINTAINER, &Impl::setMaintainer>,
        support::Scalar<&Impl::m_summary, SUMMARY, &Impl::setSummary>,
        support::Optional<&Impl::m_installedSize, INSTALLED_SIZE, &Impl::setInstalledSize>,
        support::Scalar<&Impl::m_essential, ESSENTIAL, &Impl::setIsEssential>,
        support::References<&Impl::m_groups, GROUPS, &Impl::makeGroups, &Impl::getGroups>,
        support::References<&Impl::m_provides, PROVIDES, &Impl::makeProvides, &Impl::getProvides>>;
};

inline Release::Release(Impl* impl) : ModelElement(impl) {}
inline Release::Impl* Release::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Release::Impl* Release::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace debian::model

extern template class tarn::kiln::support::Record<debian::model::Release::Impl,
                                                  tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<debian::model::Release::Impl,
                                                      tarn::kiln::ModelElement::Impl>;
