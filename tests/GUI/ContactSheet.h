#ifndef VORL_TESTS_GUI_CONTACTSHEET_H
#define VORL_TESTS_GUI_CONTACTSHEET_H

/// @file
/// Pictures of graphic objects in many states, side by side.

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/InputEventHandler.h>

#include <gtest/gtest.h>

#include "Canvas.h"

namespace gui_testing {

/// A canvas that is parted into cells of equal size, with grey lines between them.
class ContactSheet : public Canvas {
 public:
  ContactSheet(int columns, int rows, int cellWidth, int cellHeight)
      : Canvas(columns * (cellWidth + 1) + 1, rows * (cellHeight + 1) + 1),
        m_cellWidth(cellWidth),
        m_cellHeight(cellHeight) {
    Fill(static_cast<char>(0xA0));
  }
  tagRECT CellAt(int column, int row) const {
    const int left = 1 + column * (m_cellWidth + 1);
    const int top = 1 + row * (m_cellHeight + 1);
    return {left, top, left + m_cellWidth, top + m_cellHeight};
  }

 private:
  int m_cellWidth;
  int m_cellHeight;
};

/// Creates a copy of a view by click.
template <class View>
class Creator : public GraphicHandler {
 public:
  explicit Creator(const View& model) : m_model(model) {}
  VGObjectView* CreateObject(VGType /*type*/) override {
    auto* const view = new View(m_model);
    view->ResetViewState(VGViewState_Visible | VGViewState_Selected);
    view->SetDynamicCreationFlag();
    return view;
  }

 private:
  const View& m_model;
};

/// How a cell shows its objects.
struct CellLook {
  float scale = 1.0F;
  COLORREF background = 0xFFFFFF;
  bool isUpwards = false;  ///< y grows from the bottom to the top
};

/// A cell of a sheet: a viewport that shows one layer of objects, with the graphic position (0, 0)
/// in a corner. The layer must outlive it. The mouse is told in device units from the cell's top
/// left corner.
class Cell {
 public:
  Cell(const ContactSheet& sheet, int column, int row, GraphicHandler& handler,
       const CellLook& look = {})
      : m_dc(sheet), m_rect(sheet.CellAt(column, row)) {
    const float width = static_cast<float>(m_rect.right - m_rect.left) / look.scale;
    const float height = static_cast<float>(m_rect.bottom - m_rect.top) / look.scale;
    const Rect2D area(0, look.isUpwards ? height : 0, width, look.isUpwards ? 0 : height);
    viewPort.Init(area, area, Rect2D(m_rect));
    viewPort.SetBgColor(static_cast<long>(look.background));
    viewPort.SetProportional(false);
    viewPort.SetGraphic(&handler);
    viewPort.UpdateTransformation();
  }
  Cell(const Cell&) = delete;
  Cell& operator=(const Cell&) = delete;

  bool Down(int x, int y, int flags = 0) { return Send(MouseEvent_ButtonDown, x, y, flags); }
  bool Move(int x, int y, int flags = 0) { return Send(MouseEvent_Move, x, y, flags); }
  bool Up(int x, int y, int flags = 0) { return Send(MouseEvent_ButtonUp, x, y, flags); }
  void Draw() {
    // Each leaves a clip region of its own.
    int saved = SaveDC(m_dc);
    viewPort.EraseBkgnd(m_dc, nullptr, false);
    RestoreDC(m_dc, saved);
    saved = SaveDC(m_dc);
    viewPort.Draw(m_dc, nullptr, false);
    RestoreDC(m_dc, saved);
  }

  GraphicViewPort viewPort;

 private:
  bool Send(int event, int x, int y, int flags) {
    return viewPort.ProcessMouseEvent(event, MK_LBUTTON | flags,
                                      tagPOINT{m_rect.left + x, m_rect.top + y});
  }

  HDC m_dc;
  tagRECT m_rect;
};

/// A drag in the units of a cell.
struct Drag {
  tagPOINT from;
  tagPOINT to;
  int flags = 0;
};

constexpr int kNumStates = 5;

/// A row of cells with one view: as it is, selected by a click, while it is dragged, after that,
/// and created anew by a drag of the same way.
template <class View>
void DrawStates(const ContactSheet& sheet, int row, const View& model, const Drag& drag,
                const CellLook& look = {}) {
  const auto [from, to, flags] = drag;
  for (int column = 0; column < kNumStates - 1; ++column) {
    View view(model);
    view.SetViewState(VGViewState_Visible);
    GraphicHandler handler;
    handler.AddObject(&view);
    Cell cell(sheet, column, row, handler, look);
    if (column > 0) {
      EXPECT_TRUE(cell.Down(from.x, from.y, flags));
    }
    if (column > 1) {
      EXPECT_TRUE(cell.Move(to.x, to.y, flags));
    }
    if (column == 1 || column == 3) {
      EXPECT_TRUE(cell.Up(column == 1 ? from.x : to.x, column == 1 ? from.y : to.y, flags));
    }
    cell.Draw();
  }
  Creator<View> creator(model);
  creator.SetCreateMode(const_cast<View&>(model).GetObjType(), 1);
  Cell cell(sheet, kNumStates - 1, row, creator, look);
  EXPECT_TRUE(cell.Down(from.x, from.y));
  EXPECT_NE(creator.GetObject(1), nullptr);
  cell.Move(to.x, to.y);
  cell.Up(to.x, to.y);
  cell.Draw();
}

}  // namespace gui_testing

#endif
