#include "tarnkiln/kernel/Listener.h"

#include "tarnkiln/kernel/ConstellationListener.h"
#include "tarnkiln/kernel/ExtensionListener.h"

namespace tarn::kiln {

Listener::~Listener() = default;
void Listener::listenerRemoved() {}

ListenerHolderBase::ListenerHolderBase(Listener* listener, bool shallow, bool wantsPrepare,
                                       bool wantsValidate, bool wantsNotify, bool owned)
    : m_listener(listener),
      m_shallow(shallow),
      m_wantsPrepare(wantsPrepare),
      m_wantsValidate(wantsValidate),
      m_wantsNotify(wantsNotify),
      m_owned(owned)
{}

ListenerHolderBase::~ListenerHolderBase()
{
    m_listener->listenerRemoved();
    if (m_owned)
        delete m_listener;
}

ExtensionListener::~ExtensionListener() = default;
void ExtensionListener::listenerRemoved() {}

ConstellationListener::~ConstellationListener() = default;
}  // namespace tarn::kiln
