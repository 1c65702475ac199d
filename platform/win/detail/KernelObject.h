#pragma once

/// @file
/// What lies behind a handle of the system's objects.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <memory>
#include <optional>

namespace tvx::win {

/// Owns a descriptor of the system.
class TVX_PLATFORM_API Descriptor {
public:
    Descriptor() noexcept = default;
    /// Takes over what the system has just made; -1 is none. In a process that was started without standard descriptors
    /// it may have got the place of one of them, which others will write to or replace: then it moves away from there.
    explicit Descriptor(int number) noexcept;
    Descriptor(Descriptor&& other) noexcept : m_number(other.release()) {}
    Descriptor& operator=(Descriptor&& other) noexcept;
    ~Descriptor();

    int number() const noexcept {
        return m_number;
    }
    explicit operator bool() const noexcept {
        return m_number >= 0;
    }
    /// Gives the descriptor up without closing it.
    int release() noexcept;

private:
    int m_number = -1;
};

/// Waits until a descriptor is readable or its other end is closed, without being woken by signals.
/// @param timeout  milliseconds, `INFINITE` for ever
/// @return the events that are there, 0 when the time ran out
TVX_PLATFORM_API short waitReadable(int descriptor, DWORD timeout);

/// A process or an end of a pipe. It is signalled while its descriptor is readable. Any thread may use it.
class KernelObject {
public:
    explicit KernelObject(Descriptor descriptor) noexcept : m_descriptor(std::move(descriptor)) {}
    virtual ~KernelObject() = default;
    KernelObject(const KernelObject&) = delete;
    KernelObject& operator=(const KernelObject&) = delete;

    int descriptor() const noexcept {
        return m_descriptor.number();
    }

protected:
    Descriptor m_descriptor;
};

/// Whether a child may be given a handle as a standard handle.
enum class Inheritance { None, Inheritable };

/// A new handle to the object.
HANDLE makeHandle(std::shared_ptr<KernelObject> object, Inheritance inheritance);

/// The object of a handle, null with `ERROR_INVALID_HANDLE` as the last error when there is none.
TVX_PLATFORM_API std::shared_ptr<KernelObject> objectOf(HANDLE handle);

/// The same, of one kind of object.
template <class Object>
std::shared_ptr<Object> objectOf(HANDLE handle);

/// Whether a child may be given this handle.
bool isInheritable(HANDLE handle);

} // namespace tvx::win

#include "platform/win/Error.h"

template <class Object>
std::shared_ptr<Object> tvx::win::objectOf(HANDLE handle) {
    auto object = std::dynamic_pointer_cast<Object>(objectOf(handle));
    if (!object) {
        SetLastError(ERROR_INVALID_HANDLE);
    }
    return object;
}
