// SPDX-License-Identifier: MIT
#include "ostinet/Common.h"

#include "names/DestModeImpl.h"

namespace Ostinet {

template class RCPtrMT<Impl::DestModeImpl>;
template class RCPtrMT<Impl::DestNameSetImpl>;
template class RCPtrMT<Impl::PatchBankImpl>;
template class RCPtrMT<Impl::PatchImpl>;
template class RCPtrMT<Impl::ValueListImpl>;

}  // namespace Ostinet
