#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <string>

namespace zebcore::utility
{

/// A plug-in binary in memory: a bundle of the system where it has bundles.
struct OSModule;
using OSModuleRef = OSModule*;

/// A function of a module, to be cast to its real type.
using ModuleFunction = void (*)();

/// Loads the binary of a bundle, or a plain binary file. Null on failure, for whatever reason; GetLastOSModuleError
/// then tells which. The caller gives the result to ReleaseOSModule. [main]
ZEB_EXPORT OSModuleRef LoadOSModule(const UTF16String& path) noexcept;

/// Drops the reference; null is fine. Nothing of the module is to be used afterwards. [main]
ZEB_EXPORT void ReleaseOSModule(OSModuleRef module) noexcept;

/// The file that LoadOSModule would load for this path, without loading it. Empty when there is none;
/// GetLastOSModuleError then tells why. [main]
ZEB_EXPORT UTF16String FindOSModuleBinary(const UTF16String& path) noexcept;

/// A sentence about the last failure of the two operations above, which names the file; empty if neither has failed
/// yet. [main]
ZEB_EXPORT UTF16String GetLastOSModuleError();

/// What a plug-in's entry point is given: the handle of dlopen, or the CFBundleRef. Null for null. Owned by the
/// module. [main]
ZEB_EXPORT void* GetOSModuleHandle(OSModuleRef module) noexcept;

/// Path of the loaded file; empty for null. [main]
ZEB_EXPORT UTF16String GetOSModuleBinaryPath(OSModuleRef module);

/// Looks up an exported symbol. Null when the module is null or has no such symbol. [main]
ZEB_EXPORT ModuleFunction GetFunctionPointerFromModuleImpl(OSModuleRef module, const std::string& name) noexcept;

} // namespace zebcore::utility
