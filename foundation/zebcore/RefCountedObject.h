#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedInterface.h"

#include <atomic>
#include <cstdint>

namespace zebcore::utility
{

/// Base of all counted objects. A new object has count 0; the first pointer that takes it raises it to 1. An object
/// that no pointer ever held is not deleted by the count: it may stand on the stack.
class ZEB_EXPORT RefCountedObject : public virtual RefCountedInterface
{
public:
    void AddRefCount() const override;
    void ReleaseRefCount() const override;

    /// For diagnostics, and for an owner that knows that nobody else can take a reference meanwhile. [any]
    std::int32_t GetRefCount() const;

    ~RefCountedObject() override;

protected:
    RefCountedObject();
    /// The count belongs to the object, not to its value: a copy starts at 0, an assigned object keeps its own.
    RefCountedObject(const RefCountedObject& other);
    RefCountedObject& operator=(const RefCountedObject& other);

    /// An exempt object outlives its last reference; whoever exempted it destroys it. To be set before the object is
    /// shared.
    void SetExemptFromDeletion(bool exempt);

private:
    mutable std::atomic<std::int32_t> mRefCount{0};
    mutable std::uint8_t mDeleting = 0;
    std::uint8_t mExemptFromDeletion = 0;
};

} // namespace zebcore::utility
