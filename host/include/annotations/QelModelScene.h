#pragma once
// QelModelScene: the scene source of a viewer showing a product model: the shapes of the
// shown products, placed in the root's coordinates, and the shown annotations of the shown
// sets, each in the colour of its kind. Holds the root product weakly: a viewer that
// outlives its model shows nothing.
#include "QelBaseUnknown_WR.h"
#include "QelIVisuSceneSource.h"

class QelModelScene : public QelIVisuSceneSource {
 public:
  explicit QelModelScene(QelBaseUnknown* root);

  void CollectScene(QelRenderScene& scene, QelIVisuObjectFilter* filter) override;

  // The colour annotations of a type (the type name of the model file) are drawn in.
  static QelRenderColor KindColor(const std::string& typeName);

 protected:
  ~QelModelScene() override = default;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR root_;
};
