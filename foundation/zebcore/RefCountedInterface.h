#pragma once

#include "foundation/zebcore/Export.h"

namespace zebcore::utility
{

/// What a counted object answers. Always inherited virtually, so that a class can implement several interfaces over
/// one count. Both operations are const because sharing an object changes nothing that its users see.
class ZEB_EXPORT RefCountedInterface
{
public:
    /// [any]
    virtual void AddRefCount() const = 0;
    /// Destroys the object when the last reference goes. [any]
    virtual void ReleaseRefCount() const = 0;

    virtual ~RefCountedInterface();
};

/// For boost::intrusive_ptr.
inline void intrusive_ptr_add_ref(const RefCountedInterface* object)
{
    object->AddRefCount();
}
inline void intrusive_ptr_release(const RefCountedInterface* object)
{
    object->ReleaseRefCount();
}

} // namespace zebcore::utility
