// Long random lives of a handler whose callbacks delete and add objects as they please. This means
// most under a memory checker.

#include <vorl/GUI/GraphicHandler.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <random>
#include <set>
#include <vector>

namespace {

/// Lets something happen whenever it is called, and takes itself off the living when it ends.
class Mayfly : public VGObjectView {
 public:
  Mayfly(std::set<VGObjectView*>& living, std::function<void()>& mishap)
      : m_living(living), m_mishap(mishap) {
    m_living.insert(this);
    SetViewState(VGViewState_Visible);
    Enable(VGOperation_Select | VGOperation_Move);
    SetDynamicCreationFlag();
  }
  Mayfly(const Mayfly&) = delete;
  Mayfly& operator=(const Mayfly&) = delete;
  ~Mayfly() override { m_living.erase(this); }

  VGType GetObjType() override { return VGType_Point; }
  void Transform(bool /*toGraphic*/) override {}
  using VGObjectView::GetSelectionState;
  short GetSelectionState(int /*flags*/, dVect2D& p) override {
    const bool isGrabbed = GetUserData() % 8 == static_cast<long>(p.x);
    Happen();
    return isGrabbed ? VGOperation_Move : VGOperation_None;
  }
  using VGObjectView::DrawGraphic;
  void DrawGraphic(HDC /*dc*/) override { Happen(); }
  void CalcBoundingBox(HDC /*dc*/, dVect2D& /*min*/, dVect2D& /*max*/) override { Happen(); }
  bool OnBeginMove(dVect2D& /*p*/) override { return true; }
  bool OnMove(dVect2D& /*p*/) override { return true; }
  bool OnEndMove(dVect2D& /*p*/) override {
    SetOpState(VGOperation_None);
    return true;
  }

 private:
  void Happen() {
    if (m_mishap) {
      m_mishap();
    }
  }

  std::set<VGObjectView*>& m_living;
  std::function<void()>& m_mishap;
};

/// A handler that owns all objects there are, and clients that meddle.
class Life : public IGraphicHandler, public IVGObjectView {
 public:
  explicit Life(unsigned seed) : m_random(seed) {
    m_handler.SetInterface(this);
    m_mishap = [this] { SpoilTheWalk(); };
    for (int i = 0; i < 10; ++i) {
      Add();
    }
  }
  void OnDeleteObject(GraphicHandler* /*handler*/, VGObjectView* object) override {
    if (Next(8) == 0) {
      delete object;
    }
    Meddle();
  }
  void OnSelectObject(GraphicHandler* /*handler*/, VGObjectView* /*object*/) override { Meddle(); }
  void OnModifyObject(GraphicHandler* /*handler*/, VGObjectView* /*object*/) override { Meddle(); }
  void OnObjectModified(GraphicHandler* /*handler*/, VGObjectView* /*object*/) override {
    Meddle();
  }
  void OnBeginGraphicOp(VGObjectView* /*object*/, short /*operation*/) override { Meddle(); }
  void OnGraphicChanged(VGObjectView* object, short /*operation*/) override {
    if (Next(8) == 0) {
      delete object;
    }
  }
  void OnEndGraphicOp(VGObjectView* /*object*/, short /*operation*/) override { Meddle(); }

  void Step() {
    dVect2D p(static_cast<float>(Next(9)), 0.0F);
    const int events[] = {MouseEvent_ButtonDown, MouseEvent_Move, MouseEvent_ButtonUp};
    dVect2D other;
    switch (Next(9)) {
      case 0:
      case 1:
        Add();
        break;
      case 2:
        m_handler.DeleteObject(m_handler.GetObjectByUserData(Next(40)));
        break;
      case 3:
        Next(10) == 0 ? m_handler.DeleteAll() : m_handler.DeleteSelected();
        break;
      case 4:
        m_handler.Draw(nullptr);
        break;
      case 5:
        m_handler.CalcBoundingBox(nullptr, p, other);
        break;
      case 6:
        m_handler.ProcessMouseEvent(MouseEvent_ButtonDown, MK_RBUTTON, p);
        break;
      default:
        m_handler.ProcessMouseEvent(events[Next(3)], MK_LBUTTON, p);
    }
    Check();
  }
  std::size_t Population() const { return m_living.size(); }
  std::size_t Deaths() const { return m_deaths; }

 private:
  int Next(int end) { return static_cast<int>(m_random() % static_cast<unsigned>(end)); }

  void Add() {
    if (m_living.size() >= 30) {
      return;
    }
    auto* const object = new Mayfly(m_living, m_mishap);
    object->SetUserData(Next(40));
    object->SetInterface(this);
    EXPECT_TRUE(m_handler.AddObject(object));
  }
  void Meddle() {
    if (m_depth > 3) {
      return;
    }
    ++m_depth;
    const std::size_t before = m_living.size();
    switch (Next(8)) {
      case 0:
        m_handler.DeleteActive();
        break;
      case 1:
        m_handler.DeleteObject(m_handler.GetObjectByUserData(Next(40)));
        break;
      case 2:
        if (Next(4) == 0) {
          m_handler.DeleteAll();
        }
        break;
      case 3:
        Add();
        break;
      case 4:
        m_handler.Draw(nullptr);
        break;
      default:
        break;
    }
    m_deaths += before > m_living.size() ? before - m_living.size() : 0;
    --m_depth;
  }
  /// The list grows, and so may move, while it is gone through.
  void SpoilTheWalk() {
    if (Next(6) != 0 || m_depth > 3) {
      return;
    }
    ++m_depth;
    Add();
    --m_depth;
  }
  /// The handler lists exactly the living, each once, and its active object is one of them.
  void Check() {
    long number = 0;
    std::vector<long> kept;
    for (VGObjectView* const object : m_living) {
      kept.push_back(object->GetUserData());
      object->SetUserData(--number);
    }
    for (long i = -1; i >= number; --i) {
      EXPECT_NE(m_handler.GetObjectByUserData(i), nullptr);
    }
    std::size_t next = 0;
    for (VGObjectView* const object : m_living) {
      object->SetUserData(kept[next++]);
    }
    VGObjectView* const active = m_handler.GetActiveObject();
    EXPECT_TRUE(active == nullptr || m_living.count(active) == 1);
  }

  std::mt19937 m_random;
  std::set<VGObjectView*> m_living;
  std::function<void()> m_mishap;
  int m_depth = 0;
  std::size_t m_deaths = 0;
  GraphicHandler m_handler;
};

TEST(GraphicHandlerRandom, ListsTheLivingWhateverTheClientsDo) {
  std::size_t deaths = 0;
  std::size_t population = 0;
  for (unsigned seed = 1; seed <= 40; ++seed) {
    SCOPED_TRACE(seed);
    Life life(seed);
    for (int i = 0; i < 200; ++i) {
      life.Step();
    }
    deaths += life.Deaths();
    population = std::max(population, life.Population());
  }
  EXPECT_GT(deaths, 100u) << "the clients did delete objects";
  EXPECT_GT(population, 5u);
}

}  // namespace
