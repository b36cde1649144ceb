#pragma once

#include <array>
#include <string_view>

#include "frame/Picture.h"

/// The pictures of the picture styles: four families, each with five grades from 1 (bad) to 5 (best), in two sizes. The grades of a
/// family differ in shape, not in colour alone.
namespace tessel::controls {

inline constexpr int scoreGrades = 5;
inline constexpr std::array<std::string_view, 4> scoreFamilies = {"ScoreCard", "Smiley", "Traffic", "Weather"};
inline constexpr int smallSide = 16, largeSide = 32;  // in pixels at scale 1

/// All pictures of a host, drawn once when its first control wants them.
class ScorePictures {
  public:
    ScorePictures();

    /// `family` is a place in `scoreFamilies`, `grade` from 1 to 5, `side` one of the two.
    const frame::PictureRef& Of(std::size_t family, int grade, int side) const;

  private:
    using Grades = std::array<frame::PictureRef, scoreGrades>;
    std::array<Grades, scoreFamilies.size()> small_, large_;
};

}  // namespace tessel::controls
