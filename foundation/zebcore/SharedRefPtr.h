#pragma once

#include "foundation/zebcore/RefCountedInterface.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

namespace zebcore::utility
{

/// Shared owner of a counted object.
template <class T>
using SharedRefPtr = boost::intrusive_ptr<T>;

} // namespace zebcore::utility
