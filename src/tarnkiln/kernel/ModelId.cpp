#include "tarnkiln/kernel/ModelId.h"

#include "tarnkiln/kernel/Messages.h"

namespace tarn::kiln {

ModelId ModelId::parse(ustring const& text)
{
    ustring::size_type const at = text.find(u'@');
    ustring::size_type const schemeBegin = at == ustring::npos ? 0 : at + 1;
    ustring::size_type const colon = text.find(u':', schemeBegin);
    if (colon == ustring::npos)
        reportException(tarnkiln::messages::InvalidValue());

    return {at == ustring::npos ? ustring() : text.substr(0, at),
            text.substr(schemeBegin, colon - schemeBegin), text.substr(colon + 1)};
}
}  // namespace tarn::kiln
