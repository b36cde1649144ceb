#include "controls/scorecard/ScorePictures.h"

#include <span>
#include <utility>
#include <vector>

#include "frame/VectorImage.h"

namespace tessel::controls {

namespace {

using frame::Paint;
using Shape = frame::VectorShape;
using Shapes = std::span<const Shape>;

/// What a picture is put together from, from the back to the front.
using Layers = std::array<Shapes, 3>;
using Family = std::array<Layers, scoreGrades>;

constexpr std::uint32_t white = Paint(0xFFFFFF);

// Cards with a mark: two crosses, a cross, a question, a tick, a star.

namespace card16 {
constexpr std::string_view whole = "R 1 1 14 14 2.6", gloss = "M 3.4 2.5 L 12.6 2.5", edge = "R 1.5 1.5 13 13 2.2";
constexpr Shape awful[] = {{whole, Paint(0x3B3F46)}, {edge, Paint(0x6B727C), 1}, {gloss, Paint(0xFFFFFF, 0.3), 0.9}};
constexpr Shape bad[] = {{whole, Paint(0xD93A36)}, {edge, Paint(0xA82421), 1}, {gloss, Paint(0xFFFFFF, 0.35), 0.9}};
constexpr Shape maybe[] = {{whole, Paint(0xF4B52A)}, {edge, Paint(0xC58A0E), 1}, {gloss, Paint(0xFFFFFF, 0.45), 0.9}};
constexpr Shape good[] = {{whole, Paint(0x35A24A)}, {edge, Paint(0x1F7A33), 1}, {gloss, Paint(0xFFFFFF, 0.35), 0.9}};
constexpr Shape best[] = {{whole, Paint(0x1C86D1)}, {edge, Paint(0x0F62A0), 1}, {gloss, Paint(0xFFFFFF, 0.35), 0.9}};

constexpr Shape crosses[] = {{"M 3.6 6.4 L 6.8 9.6 M 6.8 6.4 L 3.6 9.6 M 9.2 6.4 L 12.4 9.6 M 12.4 6.4 L 9.2 9.6", white, 1.4}};
constexpr Shape cross[] = {{"M 5 5.2 L 11 11.2 M 11 5.2 L 5 11.2", white, 2.2}};
constexpr Shape question[] = {{"M 5.7 6 C 5.7 3.6 10.3 3.6 10.3 6.2 C 10.3 7.9 8 7.9 8 9.4", Paint(0x4A3200), 1.9},
                              {"E 8 12 1.15 1.15", Paint(0x4A3200)}};
constexpr Shape tick[] = {{"M 4.4 8.5 L 7 11.1 L 11.8 5.2", white, 2.2}};
constexpr Shape star[] = {
    {"M 8 3 L 9.5 6.4 L 13.1 6.8 L 10.4 9.2 L 11.2 12.8 L 8 11 L 4.8 12.8 L 5.6 9.2 L 2.9 6.8 L 6.5 6.4 Z", Paint(0xFFE066)}};
constexpr Family family = {{{awful, crosses}, {bad, cross}, {maybe, question}, {good, tick}, {best, star}}};
}  // namespace card16

namespace card32 {
constexpr std::string_view whole = "R 2 2 28 28 5", gloss = "M 7 4.6 L 25 4.6", edge = "R 2.5 2.5 27 27 4.5";
constexpr Shape awful[] = {{whole, Paint(0x3B3F46)}, {edge, Paint(0x6B727C), 1}, {gloss, Paint(0xFFFFFF, 0.3), 1.4}};
constexpr Shape bad[] = {{whole, Paint(0xD93A36)}, {edge, Paint(0xA82421), 1}, {gloss, Paint(0xFFFFFF, 0.35), 1.4}};
constexpr Shape maybe[] = {{whole, Paint(0xF4B52A)}, {edge, Paint(0xC58A0E), 1}, {gloss, Paint(0xFFFFFF, 0.45), 1.4}};
constexpr Shape good[] = {{whole, Paint(0x35A24A)}, {edge, Paint(0x1F7A33), 1}, {gloss, Paint(0xFFFFFF, 0.35), 1.4}};
constexpr Shape best[] = {{whole, Paint(0x1C86D1)}, {edge, Paint(0x0F62A0), 1}, {gloss, Paint(0xFFFFFF, 0.35), 1.4}};

constexpr Shape crosses[] = {
    {"M 7.2 12.8 L 13.6 19.2 M 13.6 12.8 L 7.2 19.2 M 18.4 12.8 L 24.8 19.2 M 24.8 12.8 L 18.4 19.2", white, 2.8}};
constexpr Shape cross[] = {{"M 10 10.2 L 22 22.2 M 22 10.2 L 10 22.2", white, 4}};
constexpr Shape question[] = {{"M 11.2 12 C 11.2 7 20.8 7 20.8 12.2 C 20.8 15.8 16 15.8 16 19", Paint(0x4A3200), 3.6},
                              {"E 16 24.2 2.2 2.2", Paint(0x4A3200)}};
constexpr Shape tick[] = {{"M 8.8 17 L 14 22.2 L 23.4 10.6", white, 4}};
constexpr Shape star[] = {
    {"M 16 6.2 L 19 12.9 L 26.2 13.7 L 20.8 18.5 L 22.4 25.6 L 16 22 L 9.6 25.6 L 11.2 18.5 L 5.8 13.7 L 13 12.9 Z",
     Paint(0xFFE066)},
    {"M 16 6.2 L 19 12.9 L 26.2 13.7 L 20.8 18.5 L 22.4 25.6 L 16 22 L 9.6 25.6 L 11.2 18.5 L 5.8 13.7 L 13 12.9 Z",
     Paint(0xFFE066), 1.2}};
constexpr Family family = {{{awful, crosses}, {bad, cross}, {maybe, question}, {good, tick}, {best, star}}};
}  // namespace card32

// Faces: crying, sad, unmoved, content, laughing.

constexpr std::uint32_t ink = Paint(0x4A2D0A), tear = Paint(0x2F8FE0), mouthRed = Paint(0xB3261E);

namespace smiley16 {
constexpr std::string_view disc = "E 8 8 7.2 7.2", rim = "E 8 8 6.8 6.8", eyes = "E 5.5 6.3 1 1.35 E 10.5 6.3 1 1.35";
constexpr Shape red[] = {{disc, Paint(0xF28B6B)}, {rim, Paint(0xB9502F), 0.8}};
constexpr Shape orange[] = {{disc, Paint(0xF9B14B)}, {rim, Paint(0xC27A16), 0.8}};
constexpr Shape yellow[] = {{disc, Paint(0xFDD84A)}, {rim, Paint(0xC79D12), 0.8}};
constexpr Shape lime[] = {{disc, Paint(0xD9E04A)}, {rim, Paint(0x98A014), 0.8}};
constexpr Shape green[] = {{disc, Paint(0x9ADB5A)}, {rim, Paint(0x55992A), 0.8}};

constexpr Shape crying[] = {{"M 3.6 6.8 L 6.6 5.8 M 12.4 6.8 L 9.4 5.8", ink, 1.2},
                            {"M 5.4 13 C 5.4 9.3 10.6 9.3 10.6 13 C 9.4 12.2 6.6 12.2 5.4 13 Z", mouthRed},
                            {"M 5.4 13 C 5.4 9.3 10.6 9.3 10.6 13 C 9.4 12.2 6.6 12.2 5.4 13 Z", ink, 0.7},
                            {"M 3.6 8.4 C 2 10.8 2.2 12.6 3.6 12.6 C 5 12.6 5.2 10.8 3.6 8.4 Z M 12.4 8.4 C 10.8 10.8 11 12.6 12.4 "
                             "12.6 C 13.8 12.6 14 10.8 12.4 8.4 Z",
                             tear}};
constexpr Shape sad[] = {
    {eyes, ink}, {"M 4.8 12.5 C 5.8 9.2 10.2 9.2 11.2 12.5", ink, 1.3}, {"M 3.8 4.8 L 6.2 3.7 M 12.2 4.8 L 9.8 3.7", ink, 0.9}};
constexpr Shape unmoved[] = {{eyes, ink}, {"M 5.2 10.5 L 10.8 10.5", ink, 1.2}};
constexpr Shape content[] = {{eyes, ink}, {"M 4.4 9.6 C 5.8 12.8 10.2 12.8 11.6 9.6", ink, 1.3}};
constexpr Shape laughing[] = {{"M 4 6.8 C 4.4 5 6.4 5 6.8 6.8 M 9.2 6.8 C 9.6 5 11.6 5 12 6.8", ink, 1.2},
                              {"M 3.6 8.7 L 12.4 8.7 C 12.2 14.6 3.8 14.6 3.6 8.7 Z", Paint(0x7A1712)},
                              {"M 4.4 9 L 11.6 9 L 11.3 10.6 L 4.7 10.6 Z", white}};
constexpr Family family = {{{red, crying}, {orange, sad}, {yellow, unmoved}, {lime, content}, {green, laughing}}};
}  // namespace smiley16

namespace smiley32 {
constexpr std::string_view disc = "E 16 16 14 14", rim = "E 16 16 13.5 13.5", shine = "M 7 11 C 8.4 7.6 11.4 5.8 14.6 5.2";
constexpr std::string_view eyes = "E 11.2 12.6 1.7 2.5 E 20.8 12.6 1.7 2.5";
constexpr Shape red[] = {{disc, Paint(0xF28B6B)}, {rim, Paint(0xB9502F), 1}, {shine, Paint(0xFFFFFF, 0.35), 1.6}};
constexpr Shape orange[] = {{disc, Paint(0xF9B14B)}, {rim, Paint(0xC27A16), 1}, {shine, Paint(0xFFFFFF, 0.4), 1.6}};
constexpr Shape yellow[] = {{disc, Paint(0xFDD84A)}, {rim, Paint(0xC79D12), 1}, {shine, Paint(0xFFFFFF, 0.5), 1.6}};
constexpr Shape lime[] = {{disc, Paint(0xD9E04A)}, {rim, Paint(0x98A014), 1}, {shine, Paint(0xFFFFFF, 0.5), 1.6}};
constexpr Shape green[] = {{disc, Paint(0x9ADB5A)}, {rim, Paint(0x55992A), 1}, {shine, Paint(0xFFFFFF, 0.45), 1.6}};

constexpr Shape crying[] = {
    {"M 7.6 13.6 L 13.2 11.8 M 24.4 13.6 L 18.8 11.8", ink, 2},
    {"M 7.8 9.6 L 12 7.8 M 24.2 9.6 L 20 7.8", ink, 1.3},
    {"M 10.6 25.6 C 10.6 18.4 21.4 18.4 21.4 25.6 C 19 24 13 24 10.6 25.6 Z", mouthRed},
    {"M 10.6 25.6 C 10.6 18.4 21.4 18.4 21.4 25.6 C 19 24 13 24 10.6 25.6 Z", ink, 1.2},
    {"M 7.4 16.4 C 4.4 21 4.6 24.8 7.4 24.8 C 10.2 24.8 10.4 21 7.4 16.4 Z M 24.6 16.4 C 21.6 21 21.8 24.8 24.6 24.8 C 27.4 24.8 "
     "27.6 21 "
     "24.6 16.4 Z",
     tear},
    {"M 6.2 22 C 6.2 22.8 6.6 23.4 7.2 23.6 M 23.4 22 C 23.4 22.8 23.8 23.4 24.4 23.6", Paint(0xFFFFFF, 0.7), 0.8}};
constexpr Shape sad[] = {
    {eyes, ink}, {"M 9.8 24.4 C 11.8 18.8 20.2 18.8 22.2 24.4", ink, 2}, {"M 7.8 9 L 12.2 7 M 24.2 9 L 19.8 7", ink, 1.5}};
constexpr Shape unmoved[] = {{eyes, ink}, {"M 10.2 21.8 L 21.8 21.8", ink, 2}};
constexpr Shape content[] = {{eyes, ink}, {"M 9 19 C 11.4 25.6 20.6 25.6 23 19", ink, 2}};
constexpr Shape laughing[] = {{"M 8.2 13.4 C 9 9.6 13 9.6 13.8 13.4 M 18.2 13.4 C 19 9.6 23 9.6 23.8 13.4", ink, 2},
                              {"M 7.4 17 L 24.6 17 C 24.2 29.2 7.8 29.2 7.4 17 Z", Paint(0x7A1712)},
                              {"M 11.6 24 C 13.4 21.6 18.6 21.6 20.4 24 C 18.6 26.6 13.4 26.6 11.6 24 Z", Paint(0xE8655A)},
                              {"M 8.6 17.6 L 23.4 17.6 L 22.8 20.4 L 9.2 20.4 Z", white}};
constexpr Family family = {{{red, crying}, {orange, sad}, {yellow, unmoved}, {lime, content}, {green, laughing}}};
}  // namespace smiley32

// Traffic lights: what is lit goes down from red by red and amber, amber, amber and green to green.

constexpr std::uint32_t housing = Paint(0x2E3238), housingEdge = Paint(0x7D848D), unlit = Paint(0x15171A);
constexpr std::uint32_t litRed = Paint(0xFF4B3E), litAmber = Paint(0xFFC531), litGreen = Paint(0x3EDC62);

namespace traffic16 {
constexpr std::string_view top = "E 8 3.6 1.95 1.95", middle = "E 8 8 1.95 1.95", bottom = "E 8 12.4 1.95 1.95";
constexpr std::string_view topShine = "E 7.4 3 0.6 0.6", middleShine = "E 7.4 7.4 0.6 0.6", bottomShine = "E 7.4 11.8 0.6 0.6";
constexpr std::string_view topGlow = "E 8 3.6 2.6 2.4", middleGlow = "E 8 8 2.6 2.4", bottomGlow = "E 8 12.4 2.6 2.4";
constexpr Shape post[] = {
    {"M 2 2.4 L 5 2.4 L 5 5 Z M 14 2.4 L 11 2.4 L 11 5 Z M 2 6.8 L 5 6.8 L 5 9.4 Z M 14 6.8 L 11 6.8 L 11 9.4 Z M 2 "
     "11.2 L 5 11.2 L 5 13.8 Z M 14 11.2 L 11 11.2 L 11 13.8 Z",
     Paint(0x565C64)},
    {"R 4 0.5 8 15 2.4", housing},
    {"R 4.4 0.9 7.2 14.2 2", housingEdge, 0.8},
    {top, unlit},
    {middle, unlit},
    {bottom, unlit}};
constexpr Shape red[] = {{topGlow, Paint(0xFF4B3E, 0.35)}, {top, litRed}, {topShine, Paint(0xFFFFFF, 0.7)}};
constexpr Shape amber[] = {{middleGlow, Paint(0xFFC531, 0.35)}, {middle, litAmber}, {middleShine, Paint(0xFFFFFF, 0.75)}};
constexpr Shape green[] = {{bottomGlow, Paint(0x3EDC62, 0.35)}, {bottom, litGreen}, {bottomShine, Paint(0xFFFFFF, 0.7)}};
constexpr Family family = {{{post, red}, {post, red, amber}, {post, amber}, {post, amber, green}, {post, green}}};
}  // namespace traffic16

namespace traffic32 {
constexpr std::string_view top = "E 16 7 3.7 3.7", middle = "E 16 16 3.7 3.7", bottom = "E 16 25 3.7 3.7";
constexpr std::string_view topShine = "E 14.8 5.8 1.1 1.1", middleShine = "E 14.8 14.8 1.1 1.1",
                           bottomShine = "E 14.8 23.8 1.1 1.1";
constexpr std::string_view topGlow = "E 16 7 4.6 4.4", middleGlow = "E 16 16 4.6 4.4", bottomGlow = "E 16 25 4.6 4.4";
constexpr Shape post[] = {
    {"M 4 4.6 L 10 4.6 L 10 10 Z M 28 4.6 L 22 4.6 L 22 10 Z M 4 13.6 L 10 13.6 L 10 19 Z M 28 13.6 L 22 13.6 L 22 19 "
     "Z M 4 22.6 L 10 22.6 L 10 28 Z M 28 22.6 L 22 22.6 L 22 28 Z",
     Paint(0x565C64)},
    {"R 9 1 14 30 4.4", housing},
    {"R 9.5 1.5 13 29 4", housingEdge, 1},
    {top, unlit},
    {middle, unlit},
    {bottom, unlit},
    {"M 12.4 5.8 C 13.2 2.9 18.8 2.9 19.6 5.8 M 12.4 14.8 C 13.2 11.9 18.8 11.9 19.6 14.8 M 12.4 23.8 C 13.2 20.9 "
     "18.8 20.9 19.6 23.8",
     Paint(0x565C64), 0.9}};
constexpr Shape red[] = {{topGlow, Paint(0xFF4B3E, 0.35)}, {top, litRed}, {topShine, Paint(0xFFFFFF, 0.7)}};
constexpr Shape amber[] = {{middleGlow, Paint(0xFFC531, 0.35)}, {middle, litAmber}, {middleShine, Paint(0xFFFFFF, 0.75)}};
constexpr Shape green[] = {{bottomGlow, Paint(0x3EDC62, 0.35)}, {bottom, litGreen}, {bottomShine, Paint(0xFFFFFF, 0.7)}};
constexpr Family family = {{{post, red}, {post, red, amber}, {post, amber}, {post, amber, green}, {post, green}}};
}  // namespace traffic32

// Weather: lightning, rain, clouds, sun behind a cloud, sun.

constexpr std::uint32_t sunFill = Paint(0xFFCB2E), sunEdge = Paint(0xD98E00), rayColor = Paint(0xF5A800);

namespace weather16 {
// A line around the whole cloud: each is drawn wider in the colour of the line first.
constexpr std::string_view highCloud = "E 4.6 6.6 3 2.8 E 8.4 4.8 3.6 3.6 E 11.8 6.8 2.6 2.6 R 2 5.6 12.2 3.8 1.9";
constexpr std::string_view lowCloud = "E 4.6 10.6 3 2.8 E 8.4 8.8 3.6 3.6 E 11.8 10.8 2.6 2.6 R 2 9.6 12.2 3.8 1.9";
constexpr std::string_view sideCloud = "E 6.4 11.6 2.7 2.5 E 9.6 10 3.2 3.2 E 12.4 11.8 2.3 2.3 R 4.2 10.8 10.4 3.4 1.7";
constexpr Shape storm[] = {{highCloud, Paint(0x2B313A), 1.4}, {highCloud, Paint(0x5A6472)}};
constexpr Shape lightning[] = {
    {"M 9.4 7.4 L 5.4 11.8 L 7.8 11.8 L 6.4 15.6 L 11.2 10.4 L 8.6 10.4 L 10.4 7.4 Z", Paint(0xB87400), 0.9},
    {"M 9.4 7.4 L 5.4 11.8 L 7.8 11.8 L 6.4 15.6 L 11.2 10.4 L 8.6 10.4 L 10.4 7.4 Z", Paint(0xFFD83A)}};
constexpr Shape rainCloud[] = {{highCloud, Paint(0x5B6B7E), 1.4}, {highCloud, Paint(0x9FB0C3)}};
constexpr Shape drops[] = {{"M 4.8 11.2 L 3.8 14.6 M 8.4 11.2 L 7.4 14.6 M 12 11.2 L 11 14.6", Paint(0x1E7FD6), 1.5}};
constexpr Shape cloud[] = {{lowCloud, Paint(0x7C8A99), 1.4}, {lowCloud, Paint(0xE6EDF4)}};
constexpr Shape backCloud[] = {{"E 10.6 5 3 2.9 E 13 6.6 2.2 2.2 R 8 5.4 7 3 1.5", Paint(0x7C8A99), 1.2},
                               {"E 10.6 5 3 2.9 E 13 6.6 2.2 2.2 R 8 5.4 7 3 1.5", Paint(0xBBC7D3)}};
constexpr Shape halfSun[] = {
    {"M 6 0.9 L 6 1.9 M 1 5.9 L 2 5.9 M 2.4 2.4 L 3.1 3.1 M 9.6 2.4 L 8.9 3.1 M 2.4 9.4 L 3.1 8.7", rayColor, 1.3},
    {"E 6 5.9 3.2 3.2", sunFill},
    {"E 6 5.9 3 3", sunEdge, 0.7}};
constexpr Shape frontCloud[] = {{sideCloud, Paint(0x7C8A99), 1.3}, {sideCloud, Paint(0xEEF3F8)}};
constexpr Shape sun[] = {
    {"M 8 0.9 L 8 2.3 M 8 13.7 L 8 15.1 M 0.9 8 L 2.3 8 M 13.7 8 L 15.1 8 M 3 3 L 3.9 3.9 M 13 3 L 12.1 3.9 M 3 13 L "
     "3.9 12.1 M 13 13 L 12.1 12.1",
     rayColor, 1.5},
    {"E 8 8 4.3 4.3", sunFill},
    {"E 8 8 4 4", sunEdge, 0.8}};
constexpr Family family = {{{storm, lightning}, {rainCloud, drops}, {backCloud, cloud}, {halfSun, frontCloud}, {sun}}};
}  // namespace weather16

namespace weather32 {
constexpr std::string_view highCloud = "E 9 13 6 5.6 E 16.6 9.6 7.2 7.2 E 23.6 13.6 5.2 5.2 R 4 11.4 24.6 7.4 3.7";
constexpr std::string_view lowCloud = "E 9 21 6 5.6 E 16.6 17.6 7.2 7.2 E 23.6 21.6 5.2 5.2 R 4 19.4 24.6 7.4 3.7";
constexpr std::string_view sideCloud = "E 12.8 23 5.4 5 E 19.2 19.8 6.4 6.4 E 24.8 23.4 4.6 4.6 R 8.4 21.4 20.8 6.8 3.4";
constexpr Shape storm[] = {{highCloud, Paint(0x2B313A), 2},
                           {highCloud, Paint(0x5A6472)},
                           {"M 12 6.6 C 13.4 4.6 17 3.6 19.6 5", Paint(0xFFFFFF, 0.25), 1.3}};
constexpr std::string_view bolt = "M 18.4 14.8 L 10.8 23.4 L 15.6 23.4 L 12.8 30.8 L 22.2 20.8 L 17 20.8 L 20.8 14.8 Z";
constexpr Shape lightning[] = {{bolt, Paint(0xB87400), 1.4}, {bolt, Paint(0xFFD83A)}};
constexpr Shape rainCloud[] = {{highCloud, Paint(0x5B6B7E), 2},
                               {highCloud, Paint(0x9FB0C3)},
                               {"M 12 6.6 C 13.4 4.6 17 3.6 19.6 5", Paint(0xFFFFFF, 0.5), 1.3}};
constexpr Shape drops[] = {{"M 9.6 22 L 8 26.6 M 16.6 22 L 15 26.6 M 23.6 22 L 22 26.6 M 12.2 27 L 11.4 29.6 M 19.2 27 L 18.4 29.6",
                            Paint(0x1E7FD6), 2.2}};
constexpr Shape cloud[] = {
    {lowCloud, Paint(0x7C8A99), 2}, {lowCloud, Paint(0xE6EDF4)}, {"M 12 14.6 C 13.4 12.6 17 11.6 19.6 13", Paint(0xFFFFFF), 1.3}};
constexpr Shape backCloud[] = {{"E 21.2 9.4 6 5.8 E 26 12.8 4.2 4.2 R 16 10.4 14 6 3", Paint(0x7C8A99), 1.8},
                               {"E 21.2 9.4 6 5.8 E 26 12.8 4.2 4.2 R 16 10.4 14 6 3", Paint(0xBBC7D3)}};
constexpr Shape halfSun[] = {
    {"M 12 2 L 12 4 M 2.2 11.8 L 4.2 11.8 M 5 4.8 L 6.4 6.2 M 19 4.8 L 17.6 6.2 M 5 18.8 L 6.4 17.4", rayColor, 2.2},
    {"E 12 11.8 6.2 6.2", sunFill},
    {"E 12 11.8 5.8 5.8", sunEdge, 1}};
constexpr Shape frontCloud[] = {{sideCloud, Paint(0x7C8A99), 2}, {sideCloud, Paint(0xEEF3F8)}};
constexpr Shape sun[] = {
    {"M 16 2 L 16 4.8 M 16 27.2 L 16 30 M 2 16 L 4.8 16 M 27.2 16 L 30 16 M 6.1 6.1 L 8.1 8.1 M 25.9 6.1 L 23.9 8.1 M 6.1 "
     "25.9 L 8.1 23.9 M 25.9 25.9 L 23.9 23.9",
     rayColor, 2.6},
    {"E 16 16 8.4 8.4", sunFill},
    {"E 16 16 7.9 7.9", sunEdge, 1},
    {"M 11.4 13.6 C 12.2 11.4 14 10.4 16 10.2", Paint(0xFFFFFF, 0.55), 1.4}};
constexpr Family family = {{{storm, lightning}, {rainCloud, drops}, {backCloud, cloud}, {halfSun, frontCloud}, {sun}}};
}  // namespace weather32

constexpr std::array<Family, scoreFamilies.size()> smallFamilies = {card16::family, smiley16::family, traffic16::family,
                                                                    weather16::family};
constexpr std::array<Family, scoreFamilies.size()> largeFamilies = {card32::family, smiley32::family, traffic32::family,
                                                                    weather32::family};

frame::PictureRef Draw(const Layers& layers, int side) {
    std::vector<Shape> shapes;
    for (const Shapes layer : layers) shapes.insert(shapes.end(), layer.begin(), layer.end());
    return frame::DrawnPicture(std::move(shapes), side);
}

}  // namespace

ScorePictures::ScorePictures() {
    for (std::size_t family = 0; family < scoreFamilies.size(); ++family) {
        for (std::size_t grade = 0; grade < scoreGrades; ++grade) {
            small_[family][grade] = Draw(smallFamilies[family][grade], smallSide);
            large_[family][grade] = Draw(largeFamilies[family][grade], largeSide);
        }
    }
}

const frame::PictureRef& ScorePictures::Of(std::size_t family, int grade, int side) const {
    const auto& families = side == smallSide ? small_ : large_;
    return families.at(family).at(static_cast<std::size_t>(grade - 1));
}

}  // namespace tessel::controls
