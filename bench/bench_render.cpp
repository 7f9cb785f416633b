// One 576 x 432 thumbnail of generated scenes of 1k, 10k and 100k triangles: our software
// rasterizer, and the same scene drawn by Mesa's llvmpipe through EGL (surfaceless,
// off-screen, one thread) when libEGL and the Mesa driver are there; PNG encoding of a
// thumbnail. Both renderers end with the picture in memory (llvmpipe reads it back).
#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdlib>
#include <cstring>
#include <memory>

#include "QelPngWriter.h"
#include "QelRasterizer.h"

#ifdef QEL_HAVE_EGL
#define GL_GLEXT_PROTOTYPES 1
#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <GL/gl.h>
#include <GL/glext.h>
#endif

namespace {
constexpr int kWidth = 576;
constexpr int kHeight = 432;

// A wavy surface of about `triangles` triangles filling most of the picture: every triangle
// faces the eye, so neither renderer gets to cull work away.
std::shared_ptr<const QelMeshShape> Surface(int triangles) {
  const int n = std::max(1, static_cast<int>(std::sqrt(triangles / 2.0)));
  auto m = std::make_shared<QelMeshShape>();
  for (int j = 0; j <= n; ++j)
    for (int i = 0; i <= n; ++i) {
      const float x = -1.0f + 2.0f * i / n, y = -1.0f + 2.0f * j / n;
      m->vertices.push_back({x, y, 0.08f * std::sin(9.0f * x) * std::cos(7.0f * y)});
    }
  for (int j = 0; j < n; ++j)
    for (int i = 0; i < n; ++i) {
      const uint32_t a = j * (n + 1) + i, b = a + 1, c = a + n + 1, d = c + 1;
      m->triangles.push_back({a, b, d});
      m->triangles.push_back({a, d, c});
    }
  return m;
}

QelRenderView View() {
  QelRenderView view;
  view.eye = {0.0, -2.6, 3.2};
  view.sight = QelMathPoint{0, 0, 0} - view.eye;
  view.up = {0, 0, 1};
  return view;
}

void BM_RenderOurs(benchmark::State& state) {
  QelRenderScene scene;
  scene.meshes.push_back({Surface(static_cast<int>(state.range(0))), {}, {0.62f, 0.66f, 0.72f}});
  auto image = QelMakeVar<QelPixelImage>(kWidth, kHeight);
  const QelRenderView view = View();
  for (auto _ : state) {
    QelRasterizer::Render(scene, view, *image);
    benchmark::DoNotOptimize(image->GetPixels());
  }
  state.counters["triangles"] = static_cast<double>(scene.meshes[0].shape->TriangleCount());
}

void BM_PngEncode(benchmark::State& state) {
  QelRenderScene scene;
  scene.meshes.push_back({Surface(10000), {}, {0.62f, 0.66f, 0.72f}});
  auto image = QelMakeVar<QelPixelImage>(kWidth, kHeight);
  QelRasterizer::Render(scene, View(), *image);
  std::string bytes;
  for (auto _ : state) {
    QelPngWriter::Encode(*image, bytes);
    benchmark::DoNotOptimize(bytes.data());
  }
  state.counters["bytes"] = static_cast<double>(bytes.size());
}

#ifdef QEL_HAVE_EGL
// One surfaceless llvmpipe context with a colour and depth framebuffer of thumbnail size.
struct Egl {
  EGLDisplay display = EGL_NO_DISPLAY;
  EGLContext context = EGL_NO_CONTEXT;
  GLuint fbo = 0, color = 0, depth = 0;
  std::string error;

  Egl() {
    auto getDisplay = reinterpret_cast<PFNEGLGETPLATFORMDISPLAYEXTPROC>(eglGetProcAddress("eglGetPlatformDisplayEXT"));
    if (!getDisplay) {
      error = "libEGL has no eglGetPlatformDisplayEXT";
      return;
    }
    display = getDisplay(EGL_PLATFORM_SURFACELESS_MESA, EGL_DEFAULT_DISPLAY, nullptr);
    if (display == EGL_NO_DISPLAY || !eglInitialize(display, nullptr, nullptr)) {
      error = "no surfaceless EGL display (install libegl-mesa0 and libgl1-mesa-dri)";
      display = EGL_NO_DISPLAY;
      return;
    }
    eglBindAPI(EGL_OPENGL_API);
    const EGLint attributes[] = {EGL_RENDERABLE_TYPE, EGL_OPENGL_BIT, EGL_NONE};
    EGLConfig config;
    EGLint count = 0;
    if (!eglChooseConfig(display, attributes, &config, 1, &count) || count == 0) config = nullptr;
    context = eglCreateContext(display, config, EGL_NO_CONTEXT, nullptr);
    if (context == EGL_NO_CONTEXT || !eglMakeCurrent(display, EGL_NO_SURFACE, EGL_NO_SURFACE, context)) {
      error = "no OpenGL context without a surface";
      return;
    }
    const char* renderer = reinterpret_cast<const char*>(glGetString(GL_RENDERER));
    if (!renderer || !std::strstr(renderer, "llvmpipe")) {
      error = std::string("the EGL driver is not llvmpipe: ") + (renderer ? renderer : "unknown");
      return;
    }
    glGenFramebuffers(1, &fbo);
    glBindFramebuffer(GL_FRAMEBUFFER, fbo);
    glGenRenderbuffers(1, &color);
    glBindRenderbuffer(GL_RENDERBUFFER, color);
    glRenderbufferStorage(GL_RENDERBUFFER, GL_RGB8, kWidth, kHeight);
    glFramebufferRenderbuffer(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_RENDERBUFFER, color);
    glGenRenderbuffers(1, &depth);
    glBindRenderbuffer(GL_RENDERBUFFER, depth);
    glRenderbufferStorage(GL_RENDERBUFFER, GL_DEPTH_COMPONENT24, kWidth, kHeight);
    glFramebufferRenderbuffer(GL_FRAMEBUFFER, GL_DEPTH_ATTACHMENT, GL_RENDERBUFFER, depth);
    if (glCheckFramebufferStatus(GL_FRAMEBUFFER) != GL_FRAMEBUFFER_COMPLETE) error = "incomplete framebuffer";
  }
  ~Egl() {
    if (display == EGL_NO_DISPLAY) return;
    eglMakeCurrent(display, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
    if (context != EGL_NO_CONTEXT) eglDestroyContext(display, context);
    eglTerminate(display);
  }
};

Egl* SharedEgl() {
  // One thread, as our rasterizer uses; set before the driver starts.
  setenv("LP_NUM_THREADS", "1", 1);
  setenv("GALLIUM_DRIVER", "llvmpipe", 1);
  static Egl egl;
  return &egl;
}

// The same scene, flat shaded with a light at the eye and back faces culled: fixed-function
// GL with one vertex buffer of positions and per-face normals.
void BM_RenderLlvmpipe(benchmark::State& state) {
  Egl* egl = SharedEgl();
  if (!egl->error.empty()) {
    state.SkipWithError(("llvmpipe skipped: " + egl->error).c_str());
    return;
  }
  auto shape = Surface(static_cast<int>(state.range(0)));
  std::vector<float> data;  // per vertex: normal, position
  for (const auto& t : shape->triangles) {
    const auto &a = shape->vertices[t[0]], &b = shape->vertices[t[1]], &c = shape->vertices[t[2]];
    const QelMathVector n = QelMathVector{b[0] - a[0], b[1] - a[1], b[2] - a[2]}.Cross(
        QelMathVector{c[0] - a[0], c[1] - a[1], c[2] - a[2]});
    const double len = n.Norm();
    for (const auto* v : {&a, &b, &c}) {
      data.insert(data.end(), {static_cast<float>(n.x / len), static_cast<float>(n.y / len),
                               static_cast<float>(n.z / len), (*v)[0], (*v)[1], (*v)[2]});
    }
  }
  GLuint buffer = 0;
  glGenBuffers(1, &buffer);
  glBindBuffer(GL_ARRAY_BUFFER, buffer);
  glBufferData(GL_ARRAY_BUFFER, static_cast<GLsizeiptr>(data.size() * sizeof(float)), data.data(), GL_STATIC_DRAW);
  glInterleavedArrays(GL_N3F_V3F, 0, nullptr);
  glViewport(0, 0, kWidth, kHeight);
  glEnable(GL_DEPTH_TEST);
  glEnable(GL_CULL_FACE);
  glShadeModel(GL_FLAT);
  glEnable(GL_LIGHTING);
  glEnable(GL_LIGHT0);
  glMatrixMode(GL_PROJECTION);
  glLoadIdentity();
  const double near = 0.1, far = 20.0, top = near * std::tan(15.0 * M_PI / 180.0);
  glFrustum(-top * kWidth / kHeight, top * kWidth / kHeight, -top, top, near, far);
  glMatrixMode(GL_MODELVIEW);
  glLoadIdentity();
  const GLfloat headlight[] = {0, 0, 1, 0};
  glLightfv(GL_LIGHT0, GL_POSITION, headlight);
  // Looks from (0, -2.6, 3.2) at the origin with z up, as View() does.
  const QelRenderView view = View();
  const QelMathVector f = view.sight * (1.0 / view.sight.Norm());
  QelMathVector s = f.Cross(view.up);
  s = s * (1.0 / s.Norm());
  const QelMathVector u = s.Cross(f);
  const GLdouble m[16] = {s.x, u.x, -f.x, 0, s.y, u.y, -f.y, 0, s.z, u.z, -f.z, 0, 0, 0, 0, 1};
  glMultMatrixd(m);
  glTranslated(-view.eye.x, -view.eye.y, -view.eye.z);
  std::vector<uint8_t> pixels(static_cast<size_t>(kWidth) * kHeight * 3);
  glPixelStorei(GL_PACK_ALIGNMENT, 1);
  const auto vertices = static_cast<GLsizei>(data.size() / 6);
  for (auto _ : state) {
    glClearColor(0.5f, 0.5f, 0.5f, 1.0f);
    glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
    glDrawArrays(GL_TRIANGLES, 0, vertices);
    glReadPixels(0, 0, kWidth, kHeight, GL_RGB, GL_UNSIGNED_BYTE, pixels.data());
    benchmark::DoNotOptimize(pixels.data());
  }
  glDeleteBuffers(1, &buffer);
  state.counters["triangles"] = static_cast<double>(shape->TriangleCount());
}
#else
void BM_RenderLlvmpipe(benchmark::State& state) {
  state.SkipWithError("llvmpipe skipped: built without libEGL (install libegl-dev, libegl-mesa0, libgl1-mesa-dri)");
}
#endif
}  // namespace

BENCHMARK(BM_RenderOurs)->Arg(1000)->Arg(10000)->Arg(100000)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_RenderLlvmpipe)->Arg(1000)->Arg(10000)->Arg(100000)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_PngEncode)->Unit(benchmark::kMillisecond);
BENCHMARK_MAIN();
