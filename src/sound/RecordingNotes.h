#pragma once

#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "sound/RecorderLink.h"
#include "sound/SoundList.h"

/// What would go wrong if this list were recorded now, or sounds other than expected, in the operator's
/// language. Reads the files anew and shows no box.
std::vector<std::string> RecordingNotes(const SoundList& list, const Files& files, Recorder recorder,
                                        const StringTable& strings);
