#include "foundation/zebcore/RefCountedObject.h"

namespace zebcore::utility
{

RefCountedInterface::~RefCountedInterface() = default;

RefCountedObject::RefCountedObject() = default;
RefCountedObject::RefCountedObject(const RefCountedObject& /*other*/) : RefCountedInterface()
{
}
RefCountedObject& RefCountedObject::operator=(const RefCountedObject& /*other*/)
{
    return *this;
}
RefCountedObject::~RefCountedObject() = default;

void RefCountedObject::AddRefCount() const
{
    // Whoever adds a reference already has one, which keeps the object alive: no order is needed.
    mRefCount.fetch_add(1, std::memory_order_relaxed);
}

void RefCountedObject::ReleaseRefCount() const
{
    // Release, so that what this owner did to the object comes before its destruction by another; acquire, so that
    // the destruction here comes after what the others did.
    if (mRefCount.fetch_sub(1, std::memory_order_acq_rel) != 1)
        return;
    if (mDeleting != 0 || mExemptFromDeletion != 0)
        return;
    // A reference that is taken and dropped during the destruction must not delete a second time.
    mDeleting = 1;
    delete this;
}

std::int32_t RefCountedObject::GetRefCount() const
{
    // Acquire: an owner that reads 1 also sees what the former owners did before they let go.
    return mRefCount.load(std::memory_order_acquire);
}

void RefCountedObject::SetExemptFromDeletion(bool exempt)
{
    mExemptFromDeletion = exempt ? 1 : 0;
}

} // namespace zebcore::utility
