#pragma once

#include "benchmarks/peer/PeerCatalogue.h"
#include "host/AudioFilterDescriptor.h"
#include "host/PluginModuleInfo.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <filesystem>
#include <vector>

namespace zebaudiofilterhost::benchmarks
{

/// The plug-in of that number as our catalogue and the peer's see it: the same texts, each plug-in with its own
/// bundle below a folder of its vendor.
PluginLocator LocatorOf(int index);
UTF16String FilterIDOf(int index);
boost::intrusive_ptr<PluginModuleInfo> RecordOf(int index);
boost::intrusive_ptr<AudioFilterDescriptor> DescriptorOf(int index);
PeerCatalogue::Plugin PeerPluginOf(int index);

/// Empties the catalogue and enters that many plug-ins with one filter each.
void FillCatalogue(int plugins);
void EmptyCatalogue();
/// Whether the catalogue holds these plug-ins, with the fields they were made with, in order.
bool CatalogueHolds(int plugins);

/// The numbers from 0 to below `count`, in order and in an order without a pattern, the same in each run.
std::vector<int> Ordered(int count);
std::vector<int> Shuffled(int count);

/// A folder of this process, on a file system in memory where there is one; it goes when the process ends.
const std::filesystem::path& WorkFolder();

} // namespace zebaudiofilterhost::benchmarks
