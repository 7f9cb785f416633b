#pragma once
// QelOffscreenSupport: draws what a viewer shows into a pixel image instead of its window,
// from the viewer's main viewpoint. Made by createSupport; lives for one or a few draws and
// holds the image and (weakly) the viewer's support.
#include <string>
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelPixelImage.h"
#include "QelSupport.h"

class QelOffscreenSupport : public QelBaseUnknown {
 public:
  QelOffscreenSupport(QelSupport* source, QelPixelImage* image);

  void SetBackgroundColor(float red, float green, float blue);
  // 1: annotation texts are drawn as text sprites (0: frames only).
  int GetTextSprites() const { return textSprites_; }
  void SetTextSprites(int on) { textSprites_ = on; }
  // Asks for the text sprites to be set again before the next draw.
  void SetUpdateSpritesMapsFlag(int on) { updateSprites_ = on; }
  // S_OK, or E_FAIL when the viewer is gone.
  HRESULT Draw();
  // The texts of the annotations whose label found no free place in the last draw: their
  // marks are drawn, their frames are not.
  const std::vector<std::string>& GetUnplacedLabels() const { return unplaced_; }

 protected:
  ~QelOffscreenSupport() override = default;

 private:
  QelBaseUnknown_WR source_;
  QelVar<QelPixelImage> image_;
  float background_[3] = {0.0f, 0.0f, 0.0f};
  int textSprites_ = 0;
  int updateSprites_ = 0;
  std::vector<std::string> unplaced_;
};

// An off-screen support drawing `support`'s viewer into `image`, or null for a null or
// empty argument or a support of no size. One reference for the caller.
QelVar<QelOffscreenSupport> createSupport(QelSupport* support, QelPixelImage* image);
