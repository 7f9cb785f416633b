#include "QelRasterizer.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <numbers>
#include <optional>
#include <vector>

#include "QelMathVectorf.h"
#include "QelTextRenderer.h"

namespace {
// Geometry closer to the eye than this (model units) is cut: it would project to infinity.
constexpr double kNear = 1e-2;

uint8_t Byte(float v) { return static_cast<uint8_t>(std::clamp(v, 0.0f, 1.0f) * 255.0f + 0.5f); }

// The eye's frame and the projection to pixels, fixed for one picture.
struct Frame {
  QelMathPoint eye;
  QelMathVector right, up, forward;
  double focal = 1.0;
  double cx = 0.0, cy = 0.0;

  Frame(const QelRenderView& v, int width, int height) : eye(v.eye) {
    forward = QelMathDirection(v.sight);
    if (forward.SquareNorm() == 0.0) forward = {0, 0, -1};
    right = forward.Cross(v.up);
    if (right.SquareNorm() < 1e-24) right = forward.Cross(std::abs(forward.z) < 0.9 ? QelMathVector{0, 0, 1} : QelMathVector{0, 1, 0});
    right = QelMathDirection(right);
    up = right.Cross(forward);
    const double half = std::clamp(static_cast<double>(v.fieldOfView), 1.0, 170.0) * std::numbers::pi / 360.0;
    focal = (height * 0.5) / std::tan(half);
    cx = width * 0.5;
    cy = height * 0.5;
  }
  // Eye coordinates: x right, y up, z depth in front of the eye.
  QelMathVector ToEye(const QelMathPoint& p) const {
    const QelMathVector d = p - eye;
    return {d.Dot(right), d.Dot(up), d.Dot(forward)};
  }
};

// A vertex on its way to the screen: eye coordinates, then pixels and 1/depth.
struct Vtx {
  QelMathVector e;
  float sx = 0, sy = 0, iz = 0;
};

void Project(const Frame& f, Vtx& v) {
  v.iz = static_cast<float>(1.0 / v.e.z);
  v.sx = static_cast<float>(f.cx + v.e.x * f.focal / v.e.z);
  v.sy = static_cast<float>(f.cy - v.e.y * f.focal / v.e.z);
}

struct Target {
  QelPixelImage& image;
  std::vector<float> depth;  // 1/z of the nearest surface so far; 0 is the far end
  int width, height;
};

// `hatch`, when given, is drawn on every sixth diagonal: the cap of a cut reads as solid
// section rather than as an inner wall.
void FillTriangle(Target& t, const Vtx& a, const Vtx& b, const Vtx& c, const uint8_t rgb[3],
                  const uint8_t* hatch = nullptr) {
  const float area = (b.sx - a.sx) * (c.sy - a.sy) - (b.sy - a.sy) * (c.sx - a.sx);
  if (area == 0.0f || !std::isfinite(area)) return;
  const int x0 = std::max(0, static_cast<int>(std::floor(std::min({a.sx, b.sx, c.sx}))));
  const int x1 = std::min(t.width - 1, static_cast<int>(std::ceil(std::max({a.sx, b.sx, c.sx}))));
  const int y0 = std::max(0, static_cast<int>(std::floor(std::min({a.sy, b.sy, c.sy}))));
  const int y1 = std::min(t.height - 1, static_cast<int>(std::ceil(std::max({a.sy, b.sy, c.sy}))));
  if (x0 > x1 || y0 > y1) return;
  const float inv = 1.0f / area;
  // Edge functions stepped across the box; each is positive inside for either winding
  // once multiplied by the sign of the area.
  const float e0x = (b.sy - c.sy) * inv, e0y = (c.sx - b.sx) * inv;
  const float e1x = (c.sy - a.sy) * inv, e1y = (a.sx - c.sx) * inv;
  const float e2x = (a.sy - b.sy) * inv, e2y = (b.sx - a.sx) * inv;
  const float px = x0 + 0.5f, py = y0 + 0.5f;
  float w0r = ((b.sx - px) * (c.sy - py) - (b.sy - py) * (c.sx - px)) * inv;
  float w1r = ((c.sx - px) * (a.sy - py) - (c.sy - py) * (a.sx - px)) * inv;
  float w2r = ((a.sx - px) * (b.sy - py) - (a.sy - py) * (b.sx - px)) * inv;
  uint8_t* pixels = t.image.GetPixels();
  for (int y = y0; y <= y1; ++y) {
    float w0 = w0r, w1 = w1r, w2 = w2r;
    float* zrow = t.depth.data() + static_cast<size_t>(y) * t.width;
    uint8_t* prow = pixels + static_cast<size_t>(y) * t.width * 3;
    for (int x = x0; x <= x1; ++x) {
      if (w0 >= 0.0f && w1 >= 0.0f && w2 >= 0.0f) {
        const float iz = w0 * a.iz + w1 * b.iz + w2 * c.iz;
        if (iz > zrow[x]) {
          zrow[x] = iz;
          uint8_t* p = prow + x * 3;
          const uint8_t* ink = hatch && (x + y) % 6 == 0 ? hatch : rgb;
          p[0] = ink[0];
          p[1] = ink[1];
          p[2] = ink[2];
        }
      }
      w0 += e0x;
      w1 += e1x;
      w2 += e2x;
    }
    w0r += e0y;
    w1r += e1y;
    w2r += e2y;
  }
}

// Sutherland-Hodgman against one half space (keeps d <= 0).
template <class Dist>
void ClipPolygon(std::vector<QelMathPoint>& poly, Dist dist) {
  std::vector<QelMathPoint> out;
  out.reserve(poly.size() + 2);
  for (size_t i = 0; i < poly.size(); ++i) {
    const QelMathPoint& p = poly[i];
    const QelMathPoint& q = poly[(i + 1) % poly.size()];
    const double dp = dist(p), dq = dist(q);
    if (dp <= 0.0) out.push_back(p);
    if ((dp <= 0.0) != (dq <= 0.0)) out.push_back(p + (q - p) * (dp / (dp - dq)));
  }
  poly.swap(out);
}

// A vertex of a mesh ready for the screen: pixels and 1/depth; `cut` says why it is not
// (bit 0: behind the near plane, bit 1: clipped away).
struct ScreenVtx {
  float sx = 0, sy = 0, iz = 0;
};

void DrawMesh(Target& t, const Frame& f, const QelRenderView& view, const QelRenderMesh& mesh) {
  if (!mesh.shape) return;
  const QelMeshShape& shape = *mesh.shape;
  const bool clipped = !view.clipping.empty();
  const size_t count = shape.vertices.size();
  // The eye's frame composed with the mesh's placement, once per mesh, in single precision
  // for the per-vertex work.
  const QelMathTransformation& w = mesh.toWorld;
  const QelMathVector ax[3] = {w.GetXAxis(), w.GetYAxis(), w.GetZAxis()};
  const QelMathVector rel = w.GetTranslation() - f.eye;
  float m[3][4];
  const QelMathVector rows[3] = {f.right, f.up, f.forward};
  for (int r = 0; r < 3; ++r) {
    for (int c = 0; c < 3; ++c) m[r][c] = static_cast<float>(rows[r].Dot(ax[c]));
    m[r][3] = static_cast<float>(rows[r].Dot(rel));
  }
  const float focal = static_cast<float>(f.focal), cx = static_cast<float>(f.cx), cy = static_cast<float>(f.cy);
  std::vector<std::array<float, 3>> world(count);
  std::vector<ScreenVtx> vtx(count);
  std::vector<uint8_t> cut(count, 0);
  for (size_t i = 0; i < count; ++i) {
    const auto& v = shape.vertices[i];
    const QelMathPoint p = w.Apply({v[0], v[1], v[2]});
    world[i] = {static_cast<float>(p.x), static_cast<float>(p.y), static_cast<float>(p.z)};
    const float ex = m[0][0] * v[0] + m[0][1] * v[1] + m[0][2] * v[2] + m[0][3];
    const float ey = m[1][0] * v[0] + m[1][1] * v[1] + m[1][2] * v[2] + m[1][3];
    const float ez = m[2][0] * v[0] + m[2][1] * v[1] + m[2][2] * v[2] + m[2][3];
    if (ez < kNear) {
      cut[i] |= 1;
    } else {
      const float iz = 1.0f / ez;
      vtx[i] = {cx + ex * focal * iz, cy - ey * focal * iz, iz};
    }
    for (const QelMathPlane& plane : view.clipping)
      if (plane.DistanceTo(p) > 0.0) cut[i] |= 2;
  }
  const bool mirrored = w.Determinant() < 0.0;
  const float fx = static_cast<float>(f.forward.x), fy = static_cast<float>(f.forward.y),
              fz = static_cast<float>(f.forward.z);
  for (const auto& tri : shape.triangles) {
    if (tri[0] >= count || tri[1] >= count || tri[2] >= count) continue;
    const uint8_t any = cut[tri[0]] | cut[tri[1]] | cut[tri[2]];
    const ScreenVtx &sa = vtx[tri[0]], &sb = vtx[tri[1]], &sc = vtx[tri[2]];
    bool front = true;
    if (!any) {
      // Seen from the eye a front face turns counter-clockwise, clockwise on a y-down screen.
      const float area = (sb.sx - sa.sx) * (sc.sy - sa.sy) - (sb.sy - sa.sy) * (sc.sx - sa.sx);
      if (area == 0.0f) continue;
      front = mirrored ? area > 0.0f : area < 0.0f;
      // Closed shapes show no back face unless a clipping plane opens them.
      if (!front && !clipped) continue;
    }
    const auto &a = world[tri[0]], &b = world[tri[1]], &c = world[tri[2]];
    const float ux = b[0] - a[0], uy = b[1] - a[1], uz = b[2] - a[2];
    const float vx = c[0] - a[0], vy = c[1] - a[1], vz = c[2] - a[2];
    float nx = uy * vz - uz * vy, ny = uz * vx - ux * vz, nz = ux * vy - uy * vx;
    const float nn = std::sqrt(nx * nx + ny * ny + nz * nz);
    if (nn == 0.0f) continue;
    if (any) {
      if (mirrored) nx = -nx, ny = -ny, nz = -nz;
      front = nx * static_cast<float>(f.eye.x - a[0]) + ny * static_cast<float>(f.eye.y - a[1]) +
                  nz * static_cast<float>(f.eye.z - a[2]) > 0.0f;
      if (!front && !clipped) continue;
    }
    float light = 1.0f;
    if (view.shading) light = 0.25f + 0.75f * std::abs(nx * fx + ny * fy + nz * fz) / nn;
    // An inner face seen through the cut stands for the cut face: flat and hatched, so the
    // section reads as solid material whatever the wall's slope.
    if (!front) light = 0.7f;
    const uint8_t rgb[3] = {Byte(mesh.color.r * light), Byte(mesh.color.g * light), Byte(mesh.color.b * light)};
    const uint8_t ink[3] = {Byte(mesh.color.r * 0.35f), Byte(mesh.color.g * 0.35f), Byte(mesh.color.b * 0.35f)};
    const uint8_t* hatch = front ? nullptr : ink;
    if (!any) {
      Vtx va, vb, vc;
      va.sx = sa.sx, va.sy = sa.sy, va.iz = sa.iz;
      vb.sx = sb.sx, vb.sy = sb.sy, vb.iz = sb.iz;
      vc.sx = sc.sx, vc.sy = sc.sy, vc.iz = sc.iz;
      FillTriangle(t, va, vb, vc, rgb, hatch);
      continue;
    }
    if (cut[tri[0]] & cut[tri[1]] & cut[tri[2]] & 1) continue;
    std::vector<QelMathPoint> poly{{a[0], a[1], a[2]}, {b[0], b[1], b[2]}, {c[0], c[1], c[2]}};
    for (const QelMathPlane& plane : view.clipping) {
      ClipPolygon(poly, [&](const QelMathPoint& p) { return plane.DistanceTo(p); });
      if (poly.size() < 3) break;
    }
    if (poly.size() < 3) continue;
    ClipPolygon(poly, [&](const QelMathPoint& p) { return kNear - f.ToEye(p).z; });
    if (poly.size() < 3) continue;
    std::vector<Vtx> pv(poly.size());
    for (size_t i = 0; i < poly.size(); ++i) {
      pv[i].e = f.ToEye(poly[i]);
      Project(f, pv[i]);
    }
    for (size_t i = 1; i + 1 < pv.size(); ++i) FillTriangle(t, pv[0], pv[i], pv[i + 1], rgb, hatch);
  }
}

void Blend(QelPixelImage& image, int x, int y, const uint8_t rgb[3]) { image.SetPixel(x, y, rgb[0], rgb[1], rgb[2]); }

void Line(QelPixelImage& image, int x0, int y0, int x1, int y1, const uint8_t rgb[3]) {
  const int dx = std::abs(x1 - x0), sx = x0 < x1 ? 1 : -1;
  const int dy = -std::abs(y1 - y0), sy = y0 < y1 ? 1 : -1;
  // Lines far off the picture are not walked pixel by pixel.
  if (std::max(dx, -dy) > 4 * (image.GetWidth() + image.GetHeight())) return;
  int err = dx + dy;
  for (;;) {
    Blend(image, x0, y0, rgb);
    Blend(image, x0 + 1, y0, rgb);
    if (x0 == x1 && y0 == y1) break;
    const int e2 = 2 * err;
    if (e2 >= dy) {
      err += dy;
      x0 += sx;
    }
    if (e2 <= dx) {
      err += dx;
      y0 += sy;
    }
  }
}

bool Clipped(const QelRenderView& view, const QelMathPoint& p) {
  for (const QelMathPlane& plane : view.clipping)
    if (plane.DistanceTo(p) > 1e-9) return true;
  return false;
}

// Where label frames already lie, so a later frame can move aside instead of covering one:
// annotations without a drawing of their own often share an anchor. A coarse grid keeps
// each test local, so crowded pictures stay linear in the number of labels.
class LabelPlacer {
 public:
  struct Box {
    int left, top, w, h;
  };
  LabelPlacer(int width, int height) : width_(width), height_(height), cols_(CellCount(width)), rows_(CellCount(height)) {
    grid_.resize(static_cast<size_t>(cols_) * rows_);
  }

  // The frame of size w x h for an anchor: up and right of it when that is free, else the
  // first free place among rows stacked above and below it and the same on its left. Each
  // place is pushed inside the picture first, so a frame near the border is kept whole
  // rather than cut. None when all are taken: in a crowd, a frame covering others would only
  // make both unreadable, so the anchor's mark alone stands for it and the caller says so.
  std::optional<Box> Place(int ax, int ay, int w, int h) {
    const Box first = Within({ax + 6, ay - 6 - h, w, h});
    if (Free(first)) return Mark(first);
    for (int step = 1; step <= kSteps; ++step)
      for (const int dir : {-1, 1})
        for (const int left : {ax + 6, ax - 6 - w}) {
          const Box b = Within({left, ay - 6 - h + dir * step * (h + 2), w, h});
          if (Free(b)) return Mark(b);
        }
    return std::nullopt;
  }

 private:
  static constexpr int kCell = 32, kSteps = 12;
  static int CellCount(int pixels) { return std::max(1, (pixels + kCell - 1) / kCell); }
  // `b` moved the least that puts it inside the picture (its top left corner first, for a
  // frame larger than the picture).
  Box Within(Box b) const {
    b.left = std::max(0, std::min(b.left, width_ - b.w));
    b.top = std::max(0, std::min(b.top, height_ - b.h));
    return b;
  }
  static bool Overlap(const Box& a, const Box& b) {
    return a.left < b.left + b.w && b.left < a.left + a.w && a.top < b.top + b.h && b.top < a.top + a.h;
  }
  // The cells under a box that lies at least partly in the picture: columns c0..c1, rows r0..r1.
  bool Cells(const Box& b, int& c0, int& c1, int& r0, int& r1) const {
    if (b.left + b.w <= 0 || b.top + b.h <= 0 || b.left >= width_ || b.top >= height_) return false;
    c0 = std::clamp(b.left / kCell, 0, cols_ - 1), c1 = std::clamp((b.left + b.w - 1) / kCell, 0, cols_ - 1);
    r0 = std::clamp(b.top / kCell, 0, rows_ - 1), r1 = std::clamp((b.top + b.h - 1) / kCell, 0, rows_ - 1);
    return true;
  }
  bool Free(const Box& b) const {
    int c0, c1, r0, r1;
    if (!Cells(b, c0, c1, r0, r1)) return true;
    for (int r = r0; r <= r1; ++r)
      for (int c = c0; c <= c1; ++c)
        for (const int i : grid_[static_cast<size_t>(r) * cols_ + c])
          if (Overlap(b, boxes_[i])) return false;
    return true;
  }
  Box Mark(const Box& b) {
    boxes_.push_back(b);
    const int index = static_cast<int>(boxes_.size()) - 1;
    int c0, c1, r0, r1;
    if (Cells(b, c0, c1, r0, r1))
      for (int r = r0; r <= r1; ++r)
        for (int c = c0; c <= c1; ++c) grid_[static_cast<size_t>(r) * cols_ + c].push_back(index);
    return b;
  }
  int width_, height_, cols_, rows_;
  std::vector<Box> boxes_;
  std::vector<std::vector<int>> grid_;
};

// A tolerance's characteristic symbol drawn with lines in a size x size box: the font we
// ship lacks most of them. False for a symbol not known here (drawn as text instead).
bool DrawSymbol(QelPixelImage& image, const std::string& symbol, int left, int top, int size, const uint8_t rgb[3]) {
  const double m = size * 0.22, x0 = left + m, y0 = top + m, s = size - 2 * m;
  auto line = [&](double ax, double ay, double bx, double by) {
    Line(image, static_cast<int>(std::lround(x0 + ax * s)), static_cast<int>(std::lround(y0 + ay * s)),
         static_cast<int>(std::lround(x0 + bx * s)), static_cast<int>(std::lround(y0 + by * s)), rgb);
  };
  // An arc of the circle of radius r (a fraction of the box) from angle a to b, in turns.
  auto arc = [&](double r, double a, double b) {
    const int pieces = 24;
    for (int i = 0; i < pieces; ++i) {
      const double t0 = 2 * std::numbers::pi * (a + (b - a) * i / pieces);
      const double t1 = 2 * std::numbers::pi * (a + (b - a) * (i + 1) / pieces);
      line(0.5 + r * std::cos(t0), 0.5 - r * std::sin(t0), 0.5 + r * std::cos(t1), 0.5 - r * std::sin(t1));
    }
  };
  if (symbol == "\u2316") {  // position
    arc(0.32, 0, 1), line(0, 0.5, 1, 0.5), line(0.5, 0, 0.5, 1);
  } else if (symbol == "\u23E5") {  // flatness
    line(0.25, 0.3, 1, 0.3), line(0, 0.7, 0.75, 0.7), line(0.25, 0.3, 0, 0.7), line(1, 0.3, 0.75, 0.7);
  } else if (symbol == "\u23E4") {  // straightness
    line(0, 0.5, 1, 0.5);
  } else if (symbol == "\u25CB") {  // circularity
    arc(0.45, 0, 1);
  } else if (symbol == "\u232D") {  // cylindricity
    arc(0.32, 0, 1), line(0.2, 1, 0.45, 0), line(0.55, 1, 0.8, 0);
  } else if (symbol == "\u2312") {  // profile of a line
    arc(0.45, 0, 0.5);
  } else if (symbol == "\u2313") {  // profile of a surface
    arc(0.45, 0, 0.5), line(0.05, 0.5, 0.95, 0.5);
  } else if (symbol == "\u2220") {  // angularity
    line(0, 0.9, 1, 0.9), line(0, 0.9, 0.8, 0.1);
  } else if (symbol == "\u27C2") {  // perpendicularity
    line(0, 0.95, 1, 0.95), line(0.5, 0.95, 0.5, 0);
  } else if (symbol == "\u2225") {  // parallelism
    line(0.15, 1, 0.5, 0), line(0.5, 1, 0.85, 0);
  } else if (symbol == "\u25CE") {  // concentricity, coaxiality
    arc(0.45, 0, 1), arc(0.22, 0, 1);
  } else if (symbol == "\u232F") {  // symmetry
    line(0.2, 0.25, 0.8, 0.25), line(0, 0.5, 1, 0.5), line(0.2, 0.75, 0.8, 0.75);
  } else if (symbol == "\u2197" || symbol == "\u2330") {  // circular and total runout: arrows
    line(0.1, 1, 0.6, 0), line(0.6, 0, 0.35, 0.1), line(0.6, 0, 0.6, 0.28);
    if (symbol == "\u2330") line(0.45, 1, 0.95, 0), line(0.95, 0, 0.7, 0.1), line(0.95, 0, 0.95, 0.28), line(0.1, 1, 0.45, 1);
  } else {
    return false;
  }
  return true;
}

// Material condition modifiers, circled letters the font lacks, read as "(M)" in pictures.
std::string PictureText(std::string text) {
  for (const auto& [from, to] : {std::pair<std::string, std::string>{"\u24C2", "(M)"}, {"\u24C1", "(L)"}})
    for (size_t at = text.find(from); at != std::string::npos; at = text.find(from, at)) text.replace(at, from.size(), to);
  return text;
}

// False when the annotation's frame found no free place (its mark and leaders are drawn).
bool DrawAnnotation(QelPixelImage& image, const Frame& f, const QelRenderView& view, const QelRenderAnnotation& a,
                    LabelPlacer& labels) {
  if (Clipped(view, a.anchor)) return true;
  Vtx anchor;
  anchor.e = f.ToEye(a.anchor);
  if (anchor.e.z < kNear) return true;
  Project(f, anchor);
  const uint8_t rgb[3] = {Byte(a.color.r), Byte(a.color.g), Byte(a.color.b)};
  for (size_t i = 0; i + 1 < a.segments.size(); i += 2) {
    std::vector<QelMathPoint> seg{a.segments[i], a.segments[i + 1]};
    // A leader crossing a clipping plane is drawn up to the plane.
    bool gone = false;
    for (const QelMathPlane& plane : view.clipping) {
      const double d0 = plane.DistanceTo(seg[0]), d1 = plane.DistanceTo(seg[1]);
      if (d0 > 1e-9 && d1 > 1e-9) gone = true;
      if (gone) break;
      if (d0 > 1e-9) seg[0] = seg[0] + (seg[1] - seg[0]) * (d0 / (d0 - d1));
      if (d1 > 1e-9) seg[1] = seg[1] + (seg[0] - seg[1]) * (d1 / (d1 - d0));
    }
    if (gone) continue;
    Vtx p, q;
    p.e = f.ToEye(seg[0]);
    q.e = f.ToEye(seg[1]);
    if (p.e.z < kNear || q.e.z < kNear) continue;
    Project(f, p);
    Project(f, q);
    Line(image, static_cast<int>(p.sx), static_cast<int>(p.sy), static_cast<int>(q.sx), static_cast<int>(q.sy), rgb);
  }
  const int ax = static_cast<int>(std::lround(anchor.sx)), ay = static_cast<int>(std::lround(anchor.sy));
  if (ax < -1000 || ay < -1000 || ax > image.GetWidth() + 1000 || ay > image.GetHeight() + 1000) return true;
  for (int y = -2; y <= 2; ++y)
    for (int x = -2; x <= 2; ++x) Blend(image, ax + x, ay + y, rgb);
  // The frame sits up and right of its anchor, sized to the text it holds.
  const int pad = 3;
  const int textWidth = view.text ? view.text->Measure(a.text) : 0;
  const int textHeight = view.text ? view.text->LineHeight() : 10;
  const int h = textHeight + 2 * pad;
  // A tolerance frame: a square box for its symbol, then one box per compartment.
  std::vector<std::string> parts;
  for (const std::string& part : a.compartments) parts.push_back(PictureText(part));
  std::vector<int> widths;
  int w = std::max(textWidth, 24) + 2 * pad;
  if (!parts.empty()) {
    w = h;
    for (size_t i = 1; i < parts.size(); ++i) {
      widths.push_back((view.text ? view.text->Measure(parts[i]) : 8) + 2 * pad);
      w += widths.back();
    }
  }
  const std::optional<LabelPlacer::Box> box = labels.Place(ax, ay, w, h);
  if (!box) return false;
  const int left = box->left, top = box->top;
  // A frame moved aside keeps a thin leader to its anchor.
  if (left != ax + 6 || top != ay - 6 - h)
    Line(image, ax, ay, left < ax ? left + w - 1 : left, top < ay ? top + h - 1 : top, rgb);
  const uint8_t paper[3] = {250, 250, 245};
  for (int y = top; y < top + h; ++y)
    for (int x = left; x < left + w; ++x) {
      const bool border = y < top + 2 || y >= top + h - 2 || x < left + 2 || x >= left + w - 2;
      Blend(image, x, y, border ? rgb : paper);
    }
  const QelRenderColor ink{a.color.r * 0.45f, a.color.g * 0.45f, a.color.b * 0.45f};
  if (!parts.empty()) {
    const uint8_t inkRgb[3] = {Byte(ink.r), Byte(ink.g), Byte(ink.b)};
    if (!DrawSymbol(image, parts[0], left, top, h, inkRgb) && view.text) view.text->Draw(image, left + pad, top + pad, parts[0], ink);
    int x = left + h;
    for (size_t i = 1; i < parts.size(); ++i) {
      for (int y = top; y < top + h; ++y) Blend(image, x - 1, y, rgb);
      if (view.text) view.text->Draw(image, x + pad, top + pad, parts[i], ink);
      x += widths[i - 1];
    }
  } else if (view.text && !a.text.empty()) {
    view.text->Draw(image, left + pad, top + pad, a.text, ink);
  }
  return true;
}
}  // namespace

void QelRasterizer::Render(const QelRenderScene& scene, const QelRenderView& view, QelPixelImage& image,
                           std::vector<std::string>* unplaced) {
  const int width = image.GetWidth(), height = image.GetHeight();
  if (width == 0 || height == 0) return;
  const uint8_t bg[3] = {Byte(view.background.r), Byte(view.background.g), Byte(view.background.b)};
  uint8_t* p = image.GetPixels();
  for (size_t i = 0, n = static_cast<size_t>(width) * height; i < n; ++i, p += 3) {
    p[0] = bg[0];
    p[1] = bg[1];
    p[2] = bg[2];
  }
  Target target{image, std::vector<float>(static_cast<size_t>(width) * height, 0.0f), width, height};
  const Frame frame(view, width, height);
  for (const QelRenderMesh& mesh : scene.meshes) DrawMesh(target, frame, view, mesh);
  if (view.annotations) {
    LabelPlacer labels(width, height);
    for (const QelRenderAnnotation& a : scene.annotations)
      if (!DrawAnnotation(image, frame, view, a, labels) && unplaced) unplaced->push_back(a.text);
  }
}
