#include "tarnkiln/services/internal/DiscoverServices.h"

#include "sill/i18n/StringConversion.h"
#include "tarnkiln/services/ElementIdResolver.h"
#include "tarnkiln/services/ModelIdNormalizer.h"
#include "tarnkiln/services/internal/AttachedService.h"

#include <list>
#include <mutex>

namespace tarn::kiln::internal {
namespace {

template <class Interface> struct Attachment
{
    void const* owner;
    string filter;
    DiscoveredService<Interface> service;
};

/// What is attached for one interface.
template <class Interface> struct Attachments
{
    std::mutex mutex;
    std::list<Attachment<Interface>> list;

    static Attachments& getInstance()
    {
        static Attachments attachments;
        return attachments;
    }
};
}  // namespace

template <class Interface>
AttachedService<Interface>::AttachedService(string const& filter,
                                            std::shared_ptr<Interface> service,
                                            std::optional<int> priority)
{
    auto& attachments = Attachments<Interface>::getInstance();
    std::lock_guard const lock(attachments.mutex);
    attachments.list.push_back({this, filter, {std::move(service), priority}});
}

template <class Interface> AttachedService<Interface>::~AttachedService()
{
    auto& attachments = Attachments<Interface>::getInstance();
    std::lock_guard const lock(attachments.mutex);
    attachments.list.remove_if([this](auto const& attached) { return attached.owner == this; });
}

template <class Interface>
std::vector<DiscoveredService<Interface>> discoverServices(string const& filter)
{
    auto& attachments = Attachments<Interface>::getInstance();
    std::lock_guard const lock(attachments.mutex);
    std::vector<DiscoveredService<Interface>> found;
    for (Attachment<Interface> const& attached : attachments.list)
    {
        if (attached.filter == filter)
            found.push_back(attached.service);
    }
    return found;
}

string escapeFilterValue(ustring const& value)
{
    string escaped;
    for (char const unit : sill::i18n::to_string(value))
    {
        if (unit == '\\' || unit == '*' || unit == '(' || unit == ')')
            escaped += '\\';
        escaped += unit;
    }
    return escaped;
}

template class AttachedService<services::ElementIdResolver>;
template class AttachedService<services::ModelIdNormalizer>;

template std::vector<DiscoveredService<services::ElementIdResolver>>
discoverServices(string const& filter);
template std::vector<DiscoveredService<services::ModelIdNormalizer>>
discoverServices(string const& filter);
}  // namespace tarn::kiln::internal
