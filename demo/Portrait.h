#pragma once

#include <QByteArray>
#include <QColor>
#include <QImage>

enum class Hair { Shaved, Short, SideParting, Spiky, Curly, Bob, Long, Bun, Ponytail };
enum class Beard { None, Stubble, Full };
enum class Mouth { Laughing, Smiling };
enum class Glasses { None, Round, Square };

/// How a member looks on the photograph.
struct PortraitLook {
  QRgb Skin;
  QRgb HairColour;
  ::Hair Hair;
  QRgb Shirt;
  QRgb Backdrop;
  QRgb Eyes;
  ::Mouth Mouth = ::Mouth::Laughing;
  ::Beard Beard = ::Beard::None;
  ::Glasses Glasses = ::Glasses::None;
  bool Freckles = false;
};

/// Width and height of a portrait in pixels.
inline constexpr int PortraitWidth = 360;
inline constexpr int PortraitHeight = 450;

/// Draws head and shoulders in front of a plain backdrop.
QImage DrawPortrait(const PortraitLook& look);

/// The portrait as the bytes of a JPEG file, for a print 46 mm wide. Throws std::runtime_error if the toolkit
/// cannot write one.
QByteArray PortraitFile(const PortraitLook& look);
