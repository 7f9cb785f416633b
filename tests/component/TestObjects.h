#pragma once
// Small counted classes and interfaces shared by the component model suites.
#include <string>

#include "QelDictionary.h"
#include "QelMetaObject.h"
#include "QelTie.h"
#include "QelVar.h"

class ITestGreeter : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = ITestGreeter;
  static constexpr QelIID IID = QelIID::Parse("{11111111-2222-3333-4444-555555555555}");
  virtual std::string Greet() = 0;

 protected:
  ~ITestGreeter() override = default;
};

class ITestCounter : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = ITestCounter;
  static constexpr QelIID IID = QelIID::Parse("{11111111-2222-3333-4444-666666666666}");
  virtual int Next() = 0;

 protected:
  ~ITestCounter() override = default;
};

// Implements ITestGreeter directly; ITestCounter only through a tie registered by tests.
class TestAnimal : public ITestGreeter {
 public:
  static QelVar<TestAnimal> Create(std::string name) { return QelVar<TestAnimal>::Adopt(new TestAnimal(std::move(name))); }
  static const QelMetaObject& MetaObject() {
    static const QelMetaObject& meta =
        QelMetaObject::Declare("TestAnimal", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "Tests");
    return meta;
  }
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }
  std::string Greet() override { return "I am " + name_; }
  int count = 0;

 protected:
  explicit TestAnimal(std::string name) : name_(std::move(name)) {}
  ~TestAnimal() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (void* mine = QelQueryDirect<ITestGreeter>(this, iid)) return mine;
    return QelBaseUnknown::QueryDirect(iid);
  }

 private:
  std::string name_;
};

class TestDog : public TestAnimal {
 public:
  static QelVar<TestDog> Create() { return QelVar<TestDog>::Adopt(new TestDog); }
  static const QelMetaObject& MetaObject() {
    static const QelMetaObject& meta =
        QelMetaObject::Declare("TestDog", QelMetaKind::Implementation, &TestAnimal::MetaObject(), "Tests");
    return meta;
  }
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }
  const char* GetLateType() const override { return "TestLateDog"; }

 protected:
  TestDog() : TestAnimal("dog") {}
  ~TestDog() override = default;
};

class TieCounterOfAnimal final : public QelTie<ITestCounter> {
 public:
  using QelTie::QelTie;
  int Next() override { return ++Impl<TestAnimal>()->count; }
};
