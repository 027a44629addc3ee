#include "firmware/pic24f/tool/ScratchImages.h"

#include "platform/RuntimeError.h"

ScratchImages::~ScratchImages() {
  for (const std::string& path :
       {name_, PathOf(ProgMem()), PathOf(EeData()), PathOf(Config()), PathOf(Log())}) {
    try {
      if (files_.FileExists(path)) {
        files_.Delete(path);
      }
    } catch (const RuntimeError&) {
      continue;  // the system clears its temporary folder itself
    }
  }
}
