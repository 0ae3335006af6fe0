// The frame that a viewer shows while its plane is moved: a cut or a projection of 512 x 512 pixels
// out of 512 x 512 x 300 voxels, through the display window, drawn with rulers and a cross cursor
// on 1024 x 1024 pixels. A frame is meant to take at most 5 ms on one core where it shows an
// oblique cut with interpolated samples, 25 ms where it shows the brightest voxels of all depths.
//
// "frame/.../sample", "/window" and "/draw" are the parts of "frame/...", each by itself.
#include <vorl/Data/dWindowingLUT.h>
#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/VGAxis.h>
#include <vorl/GUI/VGBitmapView.h>
#include <vorl/GUI/VGCrossCursorView.h>
#include <vorl/Operators/IP/opLookup.h>
#include <vorl/Operators/IP/opMIP.h>
#include <vorl/Operators/IP/opMPR.h>

#include <string>

#include "../Planes.h"
#include "../Screen.h"

namespace {

constexpr unsigned long kScreenEdge = 1024;
constexpr unsigned long kRulerWidth = 64;
constexpr float kMmPerPixel = 0.7F;

/// What takes the pixels out of the volume. Each frame lies one voxel further along the plane's
/// normal, so that no frame finds all of its voxels in the caches.
class Cut {
 public:
  explicit Cut(const bench::Plane& plane) : m_plane(plane) {
    bench::MakePlane(m_slice, plane, bench::Volume());
    m_corner = m_slice.GetCoordinates().origin;
    m_op.volume = &bench::Volume();
    m_op.mprSlice = &m_slice;
    m_op.SelectAlgo(MPRAlgo_Trilinear);
  }

  OpBase& Op() { return m_op; }
  dImage& Image() { return m_slice.GetImage(); }
  void MoveOn() {
    constexpr int kFrames = 100;
    m_frame = (m_frame + 1) % kFrames;
    const double voxels = static_cast<double>(bench::Shrunk(kFrames)) * m_frame / kFrames;
    m_slice.GetCoordinates().origin = m_corner + m_plane.normal * (voxels / kNormalLength);
  }

 private:
  static constexpr double kNormalLength = 16;  // of the planes of the benchmarks
  const bench::Plane& m_plane;
  dSlice m_slice;
  dVect3D m_corner;
  opMPR m_op;
  int m_frame = 0;
};

/// The brightest of all voxels behind a pixel, which looks along z, y or x.
class Depth {
 public:
  explicit Depth(char direction) {
    dVolume& volume = bench::Volume();
    const auto width = static_cast<unsigned long>(volume.GetSizeX());
    const auto height = static_cast<unsigned long>(volume.GetSizeY());
    const auto depth = static_cast<unsigned long>(volume.GetSizeZ());
    const bool alongZ = direction == 'z';
    const bool alongX = direction == 'x';
    m_slice.GetImage().Init(alongX ? height : width, alongZ ? height : depth, ImageDataType_U16,
                            "G", ImageDataOrder_Pixel, 1);
    const dVect3D through = alongZ   ? dVect3D(0, 0, static_cast<float>(depth))
                            : alongX ? dVect3D(static_cast<float>(width), 0, 0)
                                     : dVect3D(0, static_cast<float>(height), 0);
    m_slice.SetCoordinates(through * 0.5, alongX ? dVect3D(0, 1, 0) : dVect3D(1, 0, 0),
                           alongZ ? dVect3D(0, 1, 0) : dVect3D(0, 0, 1), through);
    m_op.volume = &volume;
    m_op.mipSlice = &m_slice;
    m_op.SelectAlgo(MIPAlgo_Nearest);
  }

  OpBase& Op() { return m_op; }
  dImage& Image() { return m_slice.GetImage(); }
  void MoveOn() {}

 private:
  dSlice m_slice;
  opMIP m_op;
};

/// Samples through the display window, in grey levels.
class Window {
 public:
  explicit Window(dImage& samples) {
    m_table.SetWindow(1064, 1500);
    m_op.m_pSource = &samples;
    m_op.m_pTarget = &m_levels;
    m_op.m_pLUT = &m_table;
    m_op.Run();
  }

  OpBase& Op() { return m_op; }
  dImage& Levels() { return m_levels; }

 private:
  dWindowingLUT m_table;
  dImage m_levels;
  opLookup m_op;
};

/// A picture in a viewport, with rulers in millimetres beside it and a cross cursor in its middle.
class View {
 public:
  explicit View(dImage& levels) : m_screen(kScreenEdge, kScreenEdge) {
    const float width = kMmPerPixel * static_cast<float>(levels.GetWidth());
    const float height = kMmPerPixel * static_cast<float>(levels.GetHeight());
    const auto border = static_cast<int>(bench::Shrunk(kRulerWidth));
    m_picture.Init(&levels, 0, 0, width, height);
    m_cursor.Set(width / 2, height / 2);
    m_millimetres.SetUnitText(0, "mm", "millimetres");
    Rule(m_ruler[0], {0, height}, width, TAxis_X);
    Rule(m_ruler[1], {0, 0}, height, TAxis_Y);
    Show(m_inside, m_picture);
    Show(m_inside, m_cursor);
    Show(m_around, m_ruler[0]);
    Show(m_around, m_ruler[1]);
    const Rect2D area(0, 0, width, height);
    m_viewPort.Init(area, area, Rect2D(m_screen.Rect()));
    m_viewPort.SetBorder(border, 0, 0, border);
    m_viewPort.SetBgColor(kBackground);
    m_viewPort.SetAlignment(ViewAlignment_CenterX | ViewAlignment_CenterY);
    m_viewPort.FitSize();
    m_viewPort.UpdateTransformation();
  }

  /// Everything anew; what lies in the picture is clipped to it, the rulers stand in the border.
  void Draw() {
    Step([this] { m_viewPort.EraseBkgnd(m_screen, nullptr, false); });
    Step([this] {
      m_viewPort.ClipBorders(true);
      m_viewPort.Draw(m_screen, &m_inside, nullptr, false);
    });
    Step([this] {
      m_viewPort.ClipBorders(false);
      m_viewPort.Draw(m_screen, &m_around, nullptr, false);
    });
  }

  /// Whether anything covers the background halfway between the cursor and the bottom.
  bool ShowsPicture() {
    const int x = m_screen.Width() / 2;
    const int y = m_screen.Height() * 5 / 8;
    return GetPixel(m_screen, x, y) != kBackground;
  }

 private:
  static constexpr COLORREF kBackground = 0x402010;

  /// Each begins with the whole screen to draw on.
  template <class What>
  void Step(What what) {
    const int whole = SaveDC(m_screen);
    what();
    RestoreDC(m_screen, whole);
  }
  void Rule(VGAxisView& ruler, const dVect2D& from, float length, TAxis type) {
    ruler.Init(from, length, type, "");
    ruler.SetAxisUnit(&m_millimetres);
  }
  static void Show(GraphicHandler& layer, VGObjectView& object) {
    object.SetViewState(VGViewState_Visible);
    object.SetPenColor(0xEBE8E6);
    layer.AddObject(&object);
  }

  bench::Screen m_screen;
  UnitTrafo m_millimetres;
  VGBitmapView m_picture;
  VGCrossCursorView m_cursor;
  VGAxisView m_ruler[2];
  GraphicHandler m_inside;
  GraphicHandler m_around;
  GraphicViewPort m_viewPort;
};

template <class Source, class Place>
void Frame(benchmark::State& state, const Place& place) {
  Source source(place);
  Window window(source.Image());
  View view(window.Levels());
  for (auto _ : state) {
    source.MoveOn();
    if (!source.Op().Run() || !window.Op().Run()) {
      state.SkipWithError("no picture");
      return;
    }
    view.Draw();
    benchmark::ClobberMemory();
  }
  if (!view.ShowsPicture()) {
    state.SkipWithError("nothing on the screen");
  }
}

template <class Source, class Place>
void Sample(benchmark::State& state, const Place& place) {
  Source source(place);
  for (auto _ : state) {
    source.MoveOn();
    if (!source.Op().Run()) {
      state.SkipWithError(static_cast<const char*>(source.Op().GetStatus()));
      return;
    }
    benchmark::ClobberMemory();
  }
}

template <class Source, class Place>
void ApplyWindow(benchmark::State& state, const Place& place) {
  Source source(place);
  source.Op().Run();
  Window window(source.Image());
  bench::Run(state, window.Op());
}

template <class Source, class Place>
void Draw(benchmark::State& state, const Place& place) {
  Source source(place);
  source.Op().Run();
  Window window(source.Image());
  View view(window.Levels());
  for (auto _ : state) {
    view.Draw();
    benchmark::ClobberMemory();
  }
}

template <class Source, class Place>
void RegisterFrame(const std::string& name, const Place& place) {
  using Benchmark = void (*)(benchmark::State&, const Place&);
  const std::pair<const char*, Benchmark> parts[] = {{"", Frame<Source, Place>},
                                                     {"/sample", Sample<Source, Place>},
                                                     {"/window", ApplyWindow<Source, Place>},
                                                     {"/draw", Draw<Source, Place>}};
  for (const auto& [part, benchmark] : parts) {
    benchmark::RegisterBenchmark((name + part).c_str(), benchmark, place)
        ->Unit(benchmark::kMillisecond);
  }
}

void Register() {
  for (const bench::Plane& plane : bench::kPlanes) {
    RegisterFrame<Cut>(std::string("frame/cut/") + plane.name, plane);
  }
  for (const char direction : {'z', 'y', 'x'}) {
    RegisterFrame<Depth>(std::string("frame/maximum/") + direction, direction);
  }
}

[[maybe_unused]] const bool kRegistered = (Register(), true);

}  // namespace
