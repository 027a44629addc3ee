#include "firmware/download/FirmwareEnd.h"

#include <stdexcept>

FirmwareEndTold ToldOf(FirmwareEnd end) {
  constexpr const char* invalidAddress =
      "Invalid address in program, aborting. You will likely experience unexpected program execution.";
  switch (end) {
    case FirmwareEnd::Complete:
    case FirmwareEnd::ProgramCloses:
    case FirmwareEnd::LineFailed:
      return {nullptr, true};
    case FirmwareEnd::NoLoadMode:
      return {"The device did not enter load mode.", true};
    case FirmwareEnd::Aborted:
      return {"The device did not finish loading. You are likely to experience unexpected program execution.",
              true};
    case FirmwareEnd::TimedOut:
      return {"Timed out waiting for the device. You will likely experience unexpected program execution.",
              true};
    case FirmwareEnd::WrongProduct:
      return {"Wrong Product for this firmware file. Aborting.", false};
    case FirmwareEnd::TooManyErrors:
      return {"Too many download errors, aborting. You will likely experience unexpected program execution.",
              true};
    case FirmwareEnd::TooManyEraseErrors:
      return {
          "Too many download errors (erasing), aborting. You will likely experience unexpected program "
          "execution.",
          true};
    case FirmwareEnd::InvalidLineAddress:
      return {invalidAddress, false};
    case FirmwareEnd::InvalidRowAddress:
      return {invalidAddress, true};
    case FirmwareEnd::InvalidPageAddress:
      return {
          "Invalid (erase) address in program, aborting. You will likely experience unexpected program "
          "execution.",
          false};
    case FirmwareEnd::InvalidReply:
      return {"Invalid response received, aborting.", true};
    case FirmwareEnd::InvalidEraseReply:
      return {"Invalid response received (erase), aborting.", true};
  }
  throw std::logic_error("No such end of a download");
}

OwnText AdviceFor(FirmwareStage stage) {
  switch (stage) {
    case FirmwareStage::Announcing:
      return OwnText::AdviceNoDevice;
    case FirmwareStage::Identifying:
      return OwnText::AdviceUnchanged;
    case FirmwareStage::Writing:
      return OwnText::AdviceIncomplete;
    case FirmwareStage::Finishing:
      return OwnText::AdviceUnconfirmed;
  }
  throw std::logic_error("No such stage of a download");
}
