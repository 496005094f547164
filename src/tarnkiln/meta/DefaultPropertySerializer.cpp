#include "tarnkiln/meta/DefaultPropertySerializer.h"

#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/meta/Language.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

namespace tarn::kiln::meta {

template class DefaultPropertySerializer<bool>;
template class DefaultPropertySerializer<double>;
template class DefaultPropertySerializer<int>;
template class DefaultPropertySerializer<signed char>;
template class DefaultPropertySerializer<short>;
template class DefaultPropertySerializer<long>;
template class DefaultPropertySerializer<unsigned int>;
template class DefaultPropertySerializer<unsigned char>;
template class DefaultPropertySerializer<unsigned short>;
template class DefaultPropertySerializer<unsigned long>;
template class DefaultPropertySerializer<ustring>;
template class DefaultPropertySerializer<string>;
template class DefaultPropertySerializer<UUID>;
template class DefaultPropertySerializer<boost::posix_time::ptime>;
template class DefaultPropertySerializer<Model>;
template class DefaultPropertySerializer<Language>;
}  // namespace tarn::kiln::meta
