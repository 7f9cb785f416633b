#pragma once
// QelAnnotationModel: the annotation data of one product model: its annotation sets in
// model order. Owned by the root product occurrence; it sees the root weakly, so the root
// and its data never keep each other alive.
#include <string>
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelModelBuilder.h"

class QelLumAnnotationSet;
class QelPLMProductOccurrence;

class QelAnnotationModel : public QelBaseUnknown {
 public:
  explicit QelAnnotationModel(QelPLMProductOccurrence* root);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // The model of any object of it (root, product, set, annotation...), or null.
  static QelAnnotationModel* Of(QelBaseUnknown* object);

  QelPLMProductOccurrence* Root() const;
  const std::vector<QelVar<QelLumAnnotationSet>>& Sets() const { return sets_; }
  void AddSet(QelLumAnnotationSet* set);
  const std::string& SourceName() const { return sourceName_; }
  // Set once somebody listens to the model's display changes, so that a display pass over
  // a model nobody watches costs no dispatch.
  bool IsDisplayWatched() const { return displayWatched_; }
  void WatchDisplay() { displayWatched_ = true; }
  void SetSourceName(std::string name) { sourceName_ = std::move(name); }
  const std::vector<QelModelNotRead>& NotRead() const { return notRead_; }
  void SetNotRead(std::vector<QelModelNotRead> notRead) { notRead_ = std::move(notRead); }
  const std::string& LengthUnit() const { return lengthUnit_; }
  void SetLengthUnit(std::string unit) { lengthUnit_ = std::move(unit); }

 protected:
  ~QelAnnotationModel() override;

 private:
  QelBaseUnknown_WR root_;
  std::vector<QelVar<QelLumAnnotationSet>> sets_;
  std::string sourceName_;
  std::vector<QelModelNotRead> notRead_;
  std::string lengthUnit_;
  bool displayWatched_ = false;
};
