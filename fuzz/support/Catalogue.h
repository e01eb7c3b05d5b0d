// The catalogue and the block lists of the process, of which each input finds the same state.
#pragma once

#include "foundation/zebcore/StringTypes.h"

#include <string>

namespace zebfuzz
{

extern const zebcore::UTF16String kRecordedPath;    // of the record, VST 3
extern const zebcore::UTF16String kPrivateFilterID; // of the private configuration's descriptor
extern const zebcore::UTF16String kPrivatePath;     // of that descriptor, VST 3

// Nothing in it, the directories of the technologies included.
void EmptyCatalogue();

// One record, one directory, and a private configuration with one descriptor. Costs nothing where the catalogue is so
// already.
void FillCatalogue();

// Says that the catalogue, or the private configuration, is no longer as FillCatalogue makes it.
void TouchCatalogue();

// Records, directories and descriptors, told so that equal texts mean equal catalogues.
std::string CatalogueText();

// Fails unless look-up and order of arrival tell the same, and no ID is offered twice.
void ExpectSoundCatalogue();

// Fails unless the record and the private descriptor of FillCatalogue are there.
void ExpectRecord();
void ExpectPrivateDescriptor();

} // namespace zebfuzz
