#pragma once

#include <pluginterfaces/base/funknown.h>

#include <utility>

namespace zebaudiofilterhost::vst3
{

/// One owned reference on an object of the other side's, released at the end of scope. T is an interface with an
/// `iid`.
template <class T>
class PluginPtr
{
public:
    PluginPtr() = default;
    PluginPtr(std::nullptr_t) {}
    PluginPtr(const PluginPtr& other) : PluginPtr(Retain(other.mObject)) {}
    PluginPtr(PluginPtr&& other) noexcept : mObject(std::exchange(other.mObject, nullptr)) {}
    ~PluginPtr() { Reset(); }

    PluginPtr& operator=(PluginPtr other) noexcept
    {
        std::swap(mObject, other.mObject);
        return *this;
    }

    /// Takes over a reference that the caller has, such as one that a plug-in returned.
    static PluginPtr Adopt(T* object)
    {
        PluginPtr result;
        result.mObject = object;
        return result;
    }

    /// Adds a reference of its own.
    static PluginPtr Retain(T* object)
    {
        if (object)
            object->addRef();
        return Adopt(object);
    }

    /// Null if `unknown` is null, refuses the interface, or reports success without giving one.
    static PluginPtr Query(Steinberg::FUnknown* unknown)
    {
        void* object = nullptr;
        if (!unknown || unknown->queryInterface(T::iid, &object) != Steinberg::kResultOk)
            return {};
        return Adopt(static_cast<T*>(object));
    }

    /// `Query` for anything that may be held in a pointer of this kind.
    template <class U>
    static PluginPtr Query(const PluginPtr<U>& other)
    {
        return Query(static_cast<Steinberg::FUnknown*>(other.Get()));
    }

    /// The class `classID` of the factory; null if the factory fails or gives none.
    template <class Factory>
    static PluginPtr Create(Factory& factory, const Steinberg::TUID classID)
    {
        void* object = nullptr;
        if (factory.createInstance(classID, T::iid, &object) != Steinberg::kResultOk)
            return {};
        return Adopt(static_cast<T*>(object));
    }

    T* Get() const { return mObject; }
    T* operator->() const { return mObject; }
    T& operator*() const { return *mObject; }
    explicit operator bool() const { return mObject != nullptr; }

    /// Clears before it releases, so that a plug-in that calls back meanwhile finds nothing.
    void Reset()
    {
        if (T* object = std::exchange(mObject, nullptr))
            object->release();
    }

private:
    T* mObject = nullptr;
};

} // namespace zebaudiofilterhost::vst3
