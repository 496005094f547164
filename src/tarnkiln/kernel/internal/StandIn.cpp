#include "tarnkiln/kernel/internal/StandIn.h"

#include "tarnkiln/kernel/internal/uuidText.h"

#include <algorithm>
#include <memory>

namespace tarn::kiln::internal {
namespace {

/// Whether the text of `uuid` is all that there is to say.
bool isPlainUuid(ElementId const& id, UUID& uuid)
{
    auto const isUpper = [](char16_t letter) { return letter >= u'A' && letter <= u'F'; };
    ustring const& text = id.getId();
    return id.getType() == ElementId::UUID_TYPE && parseUuidText(text, uuid) &&
           std::none_of(text.begin(), text.end(), isUpper);
}
}  // namespace

StandIn::StandIn(ModelElement::Impl& proxy, ProxyId const& id, StandIns& all)
    : m_proxy(proxy),
      m_all(&all),
      m_isUuid(isPlainUuid(id, m_uuid)),
      m_modelName(id.getModelId() ? all.names().get(*id.getModelId()) : ModelNames::Handle())
{
    if (!m_isUuid)
        m_id = new ProxyId(id);
    all.insert(*this);
}

StandIn::~StandIn()
{
    if (m_all)
        m_all->erase(*this);
    delete m_id.load();
}

ProxyId const& StandIn::getId() const
{
    if (ProxyId const* const known = m_id.load(std::memory_order_acquire))
        return *known;
    boost::optional<ustring> model;
    if (m_modelName)
        model = m_modelName.get()->text();
    auto made = std::make_unique<ProxyId const>(ElementId(ElementId::UUID_TYPE, uuidText(m_uuid)),
                                                std::move(model));
    ProxyId const* present = nullptr;
    if (!m_id.compare_exchange_strong(present, made.get(), std::memory_order_acq_rel))
        return *present;
    return *made.release();
}

void StandIns::insert(StandIn& one)
{
    one.m_all = this;
    m_all.insert(one);
}

void StandIns::erase(StandIn& one)
{
    m_all.erase(one);
    one.m_all = nullptr;
}
}  // namespace tarn::kiln::internal
