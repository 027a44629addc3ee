#include "firmware/files/FirmwareFile.h"

FirmwareFileType TypeOf(std::string_view fileName) {
  return fileName.ends_with("qvm")    ? FirmwareFileType::Qvm
         : fileName.ends_with("qvm2") ? FirmwareFileType::Qvm2
                                      : FirmwareFileType::None;
}
