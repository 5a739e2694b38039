#include "explained_view.h"

#include <cairo.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>
#include <utility>

#include "chain_template.h"
#include "editor/wrapping_arithmetic.h"
#include "frame/setting_text.h"
#include "host.h"
#include "shown_text.h"

namespace editor_preview {

namespace {

constexpr double kPi = 3.14159265358979323846;
constexpr int64_t kMargin = 24;        // pixels of the editor around the drawing
constexpr int64_t kFarthest = 100000;  // the stand-in's canvas draws nothing farther out
constexpr int32_t kMostLinks = 1000;   // links placed by the run-time step for the picture
constexpr double kFontSize = 12.0;
constexpr double kLineHeight = 16.0;
constexpr double kCaptionPad = 8.0;

struct Colour {
  double r, g, b;
};
constexpr Colour kBlack{0, 0, 0}, kGrey{0.4, 0.4, 0.4}, kArc{0.0, 0.55, 0.0}, kRunTime{0.95, 0.45, 0.0},
    kSelection{0.1, 0.3, 0.9};

// A rectangle of editor coordinates, grown by what it must hold.
struct Box {
  int64_t left = std::numeric_limits<int64_t>::max(), top = std::numeric_limits<int64_t>::max();
  int64_t right = std::numeric_limits<int64_t>::min(), bottom = std::numeric_limits<int64_t>::min();

  void Add(int64_t x, int64_t y) {
    left = std::min(left, x);
    top = std::min(top, y);
    right = std::max(right, x);
    bottom = std::max(bottom, y);
  }
  void AddCentred(int64_t x, int64_t y, int64_t width, int64_t height) {
    Add(x - std::abs(width) / 2, y - std::abs(height) / 2);
    Add(x + std::abs(width) / 2, y + std::abs(height) / 2);
  }
};

// Where the library drew, from the calls the stand-in recorded: rectangles
// and the rectangles of its labels.
void AddDrawing(Box& box, const std::vector<std::string>& calls) {
  for (const std::string& call : calls) {
    std::istringstream words;
    if (call.rfind("Rectangle editor ", 0) == 0) {
      words.str(call.substr(17));
    } else if (call.rfind("DrawText editor ", 0) == 0) {
      words.str(call.substr(call.rfind('"') + 1));
      long long length = 0;
      words >> length;
    } else {
      continue;
    }
    long long x1 = 0, y1 = 0, x2 = 0, y2 = 0;
    if (words >> x1 >> y1 >> x2 >> y2) {
      box.Add(x1, y1);
      box.Add(x2, y2);
    }
  }
}

// The anchor, links and platform of one chain built from the template as
// the run-time step places them when a chain is updated at the starting
// angle: the library's own step, through the stand-in host.
struct RunTimeChain {
  std::vector<POINT> links;
  POINT platform{};
};

RunTimeChain PlaceRunTimeChain(const EditData& settings, int32_t cx, int32_t cy) {
  constexpr int kAddAnchor = 0, kAddLink = 1, kAddPlatform = 2, kUpdateAll = 13;
  standin::Host host(settings);
  RunTimeChain chain;
  if (!host.created()) return chain;
  const auto pass = [](HostObject* object) { return reinterpret_cast<intptr_t>(object); };
  host.Action(kAddAnchor, pass(host.AddObject(cx, cy, settings.anchorHeight)));
  std::vector<HostObject*> links;
  for (int32_t k = 0; k < settings.linkCount; ++k) {
    links.push_back(host.AddObject(cx, cy, settings.linkHeight));
    host.Action(kAddLink, pass(links.back()));
  }
  HostObject* platform = host.AddObject(cx, cy, settings.platformHeight);
  host.Action(kAddPlatform, pass(platform));
  host.Action(kUpdateAll);
  for (const HostObject* link : links) chain.links.push_back({link->head.x, link->head.y});
  chain.platform = {platform->head.x, platform->head.y};
  return chain;
}

struct CaptionLine {
  std::string text;
  Colour colour;
};

// The arc the platform's centre travels, in degrees of the display's angle
// (90 hangs straight down), or nothing to draw.
struct Arc {
  double from = 0, to = 0;
  double radius = 0;
};

double Radians(double degrees) { return degrees * kPi / 180; }

// The point of the arc at `degrees`, from its centre.
std::pair<double, double> ArcOffset(const Arc& arc, double degrees) {
  return {arc.radius * std::cos(Radians(degrees)), arc.radius * std::sin(Radians(degrees))};
}

Arc PlatformArc(const ChainTemplate& chain) {
  Arc arc;
  arc.radius = std::abs(static_cast<double>(chain.drawnRadius));
  const double swing = std::min(std::abs(static_cast<double>(chain.angle)), 180.0);
  // A negative radius puts every platform on the opposite side of the anchor.
  const double middle = chain.drawnRadius < 0 ? 270.0 : 90.0;
  arc.from = middle - swing;
  arc.to = middle + swing;
  return arc;
}

cairo_status_t ReadBytes(void* closure, unsigned char* data, unsigned int length) {
  auto* bytes = static_cast<std::string_view*>(closure);
  if (bytes->size() < length) return CAIRO_STATUS_READ_ERROR;
  std::copy_n(bytes->data(), length, data);
  bytes->remove_prefix(length);
  return CAIRO_STATUS_SUCCESS;
}

// The stand-in window's picture, as a cairo image.
cairo_surface_t* WindowImage(const standin::EditorWindow& window) {
  char* buffer = nullptr;
  std::size_t size = 0;
  std::FILE* memory = open_memstream(&buffer, &size);
  if (memory == nullptr) throw std::runtime_error("out of memory");
  const bool written = window.WritePng(memory);
  std::fclose(memory);
  std::unique_ptr<char, decltype(&std::free)> owned(buffer, &std::free);
  if (!written) throw std::runtime_error("the editor's picture could not be made");
  std::string_view bytes(buffer, size);
  return cairo_image_surface_create_from_png_stream(&ReadBytes, &bytes);
}

class Painter {
 public:
  explicit Painter(cairo_t* cr) : cr_(cr) {}

  void Stroke(Colour colour, bool dashed = false) {
    // Lines one and a half pixels wide at any scale: widths in pixels.
    cairo_save(cr_);
    cairo_identity_matrix(cr_);
    cairo_set_source_rgba(cr_, colour.r, colour.g, colour.b, 0.85);
    cairo_set_line_width(cr_, 1.5);
    if (dashed) {
      const double dash[] = {6.0, 4.0};
      cairo_set_dash(cr_, dash, 2, 0);
    }
    cairo_stroke(cr_);
    cairo_restore(cr_);
  }
  void Rectangle(double x, double y, double width, double height, Colour colour, bool dashed = false) {
    cairo_rectangle(cr_, x, y, width, height);
    Stroke(colour, dashed);
  }
  // An object's rectangle, centred on its position as the player draws it.
  void Centred(const POINT& at, int32_t width, int32_t height, Colour colour) {
    Rectangle(at.x - width / 2.0, at.y - height / 2.0, width, height, colour);
  }
  // Text at a pixel size whatever the scale, its top-left corner (or the
  // middle of its top) at (x, y) of the editor.
  void Text(double x, double y, const std::string& text, Colour colour, bool centred = false) {
    cairo_user_to_device(cr_, &x, &y);
    if (centred) {
      cairo_text_extents_t extents;
      cairo_text_extents(cr_, text.c_str(), &extents);
      x -= extents.x_advance / 2;
    }
    cairo_save(cr_);
    cairo_identity_matrix(cr_);
    cairo_set_source_rgb(cr_, colour.r, colour.g, colour.b);
    cairo_move_to(cr_, x, y + kFontSize);
    cairo_show_text(cr_, text.c_str());
    cairo_restore(cr_);
  }

 private:
  cairo_t* cr_;
};

void UseCaptionFont(cairo_t* cr) {
  cairo_select_font_face(cr, "sans-serif", CAIRO_FONT_SLANT_NORMAL, CAIRO_FONT_WEIGHT_NORMAL);
  cairo_set_font_size(cr, kFontSize);
}

struct CairoDeleter {
  void operator()(cairo_t* cr) const { cairo_destroy(cr); }
  void operator()(cairo_surface_t* surface) const { cairo_surface_destroy(surface); }
};

}  // namespace

PictureSize WriteExplainedView(std::FILE* stream, const PreviewOptions& options, const Drawing& drawing) {
  const EditData& settings = drawing.settings;
  const RECT& rect = drawing.rect;
  const ChainTemplate chain(options.settings);
  const bool isTemplate = settings.viewTemplate == 1;
  const int32_t cx = WrapAdd(rect.left, WrapSub(rect.right, rect.left) / 2);
  const int32_t cy = WrapAdd(rect.top, WrapSub(rect.bottom, rect.top) / 2);
  const Arc arc = PlatformArc(chain);
  const std::string swing = std::to_string(std::abs(int64_t{chain.angle}));  // the platforms' angle either side
  const bool placesLinks = isTemplate && settings.linkCount <= kMostLinks;
  const RunTimeChain runTime = placesLinks ? PlaceRunTimeChain(settings, cx, cy) : RunTimeChain{};

  // Everything shown, in editor coordinates.
  Box box;
  box.Add(rect.left, rect.top);
  box.Add(rect.right, rect.bottom);
  AddDrawing(box, drawing.calls);
  if (isTemplate) {
    for (double degrees = arc.from; degrees <= arc.to; degrees += 1.0) {
      const auto [dx, dy] = ArcOffset(arc, degrees);
      box.Add(cx + std::llround(dx), cy + std::llround(dy));
    }
    for (const POINT& link : runTime.links) box.AddCentred(link.x, link.y, settings.linkWidth, settings.linkHeight);
    if (placesLinks) {
      box.AddCentred(runTime.platform.x, runTime.platform.y, settings.platformWidth, settings.platformHeight);
    }
  }
  box.left = std::clamp(box.left - kMargin, -kFarthest, kFarthest);
  box.top = std::clamp(box.top - kMargin, -kFarthest, kFarthest);
  box.right = std::clamp(box.right + kMargin, box.left + 1, kFarthest);
  box.bottom = std::clamp(box.bottom + 2 * kMargin, box.top + 1, kFarthest);

  // The caption.
  std::vector<CaptionLine> caption;
  const std::string size = std::to_string(settings.objectWidth) + " x " + std::to_string(settings.objectHeight);
  if (isTemplate) {
    caption.push_back({"The template view, as the frame editor draws it (red), explained", kBlack});
    caption.push_back({"radius " + Whole(chain.radius) + " = (link height " + std::to_string(settings.linkHeight) +
                           " + link spacing " + std::to_string(chain.spacing) + ") x (" +
                           std::to_string(settings.linkCount) + " links + 1): from the anchor's centre to each "
                           "platform's centre",
                       kBlack});
    caption.push_back({"green: the arc the platform travels, drawn at -" + swing + ", 0 and +" + swing +
                           " degrees; positive angles swing to the left (smaller x)",
                       kArc});
    const double startAngle = ParseDecimalPrefix(settings.startAngleText);
    caption.push_back({placesLinks ? "orange: the links and the platform as the run-time step places them at the "
                                     "starting angle, " + tool_input::ShownNumber(static_cast<float>(startAngle)) + " degrees"
                                   : "the links are not placed: more than " + std::to_string(kMostLinks),
                       kRunTime});
  } else if (settings.viewTemplate == 0) {
    caption.push_back({"The picture view, as the frame editor draws it: the object's picture at its top-left corner",
                       kBlack});
    caption.push_back({"--view-template 1 draws the template of one chain instead", kBlack});
  } else {
    caption.push_back({"view-template " + std::to_string(settings.viewTemplate) +
                           ": the frame editor draws nothing and keeps the stored size",
                       kBlack});
  }
  caption.push_back({"blue, dashed: the object's rectangle, " + size + ", which the editor selects", kSelection});

  // The scale: the drawing and the caption fit a picture.
  const int64_t captionHeight = static_cast<int64_t>(kCaptionPad * 2 + kLineHeight * static_cast<double>(caption.size() + 1));
  PictureSize picture;
  picture.divisor = std::max(Divisor(box.right - box.left, kLargestSide),
                             Divisor(box.bottom - box.top, kLargestSide - captionHeight));
  if (picture.divisor > 1) {
    caption.push_back({"drawn at 1/" + std::to_string(picture.divisor) + " of its size: the whole of it is larger "
                                                                          "than a picture of 4096 pixels",
                       kGrey});
  }
  const double scale = 1.0 / picture.divisor;
  const auto drawnWidth = static_cast<int32_t>((box.right - box.left + picture.divisor - 1) / picture.divisor);
  const auto drawnHeight = static_cast<int32_t>((box.bottom - box.top + picture.divisor - 1) / picture.divisor);

  // The library's drawing, in a window that shows all of it.
  standin::EditorWindow window(drawnWidth, drawnHeight);
  window.View(static_cast<int32_t>(box.left), static_cast<int32_t>(box.top), scale);
  EditData shown = options.settings;
  RunDisplay(window, shown, options.left, options.top);
  const std::unique_ptr<cairo_surface_t, CairoDeleter> library(WindowImage(window));

  // Measure the caption on a scratch surface.
  double captionWidth = 0;
  {
    const std::unique_ptr<cairo_surface_t, CairoDeleter> scratch(cairo_image_surface_create(CAIRO_FORMAT_RGB24, 1, 1));
    const std::unique_ptr<cairo_t, CairoDeleter> cr(cairo_create(scratch.get()));
    UseCaptionFont(cr.get());
    for (const CaptionLine& line : caption) {
      cairo_text_extents_t extents;
      cairo_text_extents(cr.get(), line.text.c_str(), &extents);
      captionWidth = std::max(captionWidth, extents.x_advance);
    }
  }
  picture.width = static_cast<int32_t>(std::clamp<double>(std::max<double>(drawnWidth, captionWidth + 2 * kCaptionPad),
                                                          1, kLargestSide));
  picture.height = static_cast<int32_t>(captionHeight + drawnHeight);

  const std::unique_ptr<cairo_surface_t, CairoDeleter> surface(
      cairo_image_surface_create(CAIRO_FORMAT_RGB24, picture.width, picture.height));
  const std::unique_ptr<cairo_t, CairoDeleter> cr(cairo_create(surface.get()));
  cairo_set_source_rgb(cr.get(), 1, 1, 1);
  cairo_paint(cr.get());
  UseCaptionFont(cr.get());
  Painter paint(cr.get());
  for (std::size_t i = 0; i < caption.size(); ++i) {
    paint.Text(kCaptionPad, kCaptionPad + kLineHeight * static_cast<double>(i), caption[i].text, caption[i].colour);
  }
  cairo_set_source_surface(cr.get(), library.get(), 0, static_cast<double>(captionHeight));
  cairo_paint(cr.get());

  // The explanations, in editor coordinates.
  cairo_translate(cr.get(), 0, static_cast<double>(captionHeight));
  cairo_scale(cr.get(), scale, scale);
  cairo_translate(cr.get(), static_cast<double>(-box.left), static_cast<double>(-box.top));
  if (isTemplate && arc.radius > 0) {
    cairo_new_sub_path(cr.get());
    cairo_arc(cr.get(), cx, cy, arc.radius, Radians(arc.from), Radians(arc.to));
    paint.Stroke(kArc);
    const std::pair<double, std::string> ends[] = {{arc.from, "-"}, {arc.to, "+"}};
    for (const auto& [degrees, sign] : ends) {
      const auto [dx, dy] = ArcOffset(arc, degrees);
      paint.Text(cx + dx, cy + dy + std::abs(static_cast<double>(settings.platformHeight)) / 2.0 + 4 / scale,
                 sign + swing + " degrees", kArc, true);
    }
  }
  if (placesLinks) {
    cairo_move_to(cr.get(), cx, cy);
    for (const POINT& link : runTime.links) cairo_line_to(cr.get(), link.x, link.y);
    cairo_line_to(cr.get(), runTime.platform.x, runTime.platform.y);
    paint.Stroke(kRunTime);
    for (const POINT& link : runTime.links) paint.Centred(link, settings.linkWidth, settings.linkHeight, kRunTime);
    paint.Centred(runTime.platform, settings.platformWidth, settings.platformHeight, kRunTime);
  }
  paint.Rectangle(rect.left, rect.top, static_cast<double>(rect.right) - rect.left,
                  static_cast<double>(rect.bottom) - rect.top, kSelection, true);

  cairo_surface_flush(surface.get());
  const auto write = [](void* closure, const unsigned char* data, unsigned int length) {
    return std::fwrite(data, 1, length, static_cast<std::FILE*>(closure)) == length ? CAIRO_STATUS_SUCCESS
                                                                                     : CAIRO_STATUS_WRITE_ERROR;
  };
  if (cairo_surface_write_to_png_stream(surface.get(), write, stream) != CAIRO_STATUS_SUCCESS) {
    throw std::runtime_error("cannot write " + tool_input::Shown(options.output));
  }
  return picture;
}

}  // namespace editor_preview
