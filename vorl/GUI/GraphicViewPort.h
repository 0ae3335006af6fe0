#ifndef VORL_GUI_GRAPHICVIEWPORT_H
#define VORL_GUI_GRAPHICVIEWPORT_H

/// @file
/// The part of a plane of graphics that a rectangle of a device shows: zooming, panning, moving
/// and scrolling it, and drawing what it shows.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/GraphicViewPortModes.h>
#include <vorl/GUI/Rect2D.h>
#include <vorl/GUI/Trafo2D.h>
#include <vorl/Platform/Gdi.h>
#include <vorl/export.h>

#include <cstdint>
#include <memory>
#include <vector>

inline namespace vorl {

class GraphicHandler;
class GraphicViewPort;
class VGObjectView;

/// Tells an application what happens to a viewport.
class VORL_API IGraphicViewPort {
 public:
  IGraphicViewPort();
  IGraphicViewPort(const IGraphicViewPort& source);
  IGraphicViewPort& operator=(const IGraphicViewPort& source);

  /// The transformation has been computed anew. Does nothing here.
  virtual void OnTrafoChanged(GraphicViewPort* viewPort);

  virtual ~IGraphicViewPort();
};

/// Maps a rectangle of graphic coordinates onto a rectangle of a device, keeps that mapping inside
/// limits while the user zooms, pans and drags, and draws and feeds the graphic handlers that it
/// shows.
///
/// *Rectangles.* The graphic area is the extent of the content; the graphic window is the part of
/// the plane that is shown; the view window is the rectangle of the device that the viewport fills,
/// in pixels; the draw window is the view window without its borders. The transformation maps the
/// graphic window (side A) onto the draw window (side B).
///
/// *Scales* are relative to the original scale: at scale 1 a graphic unit takes as many pixels as
/// the original scale says. The limits are scales.
///
/// *Recomputing.* Setters change rectangles, modes and limits only. `UpdateTransformation` applies
/// them: it sizes the graphic window by the modes and limits, moves it over the graphic area, and
/// computes the transformation. Where a function calls it itself, that is said.
///
/// *Ownership.* Handlers and the interface belong to the caller. A handler that is destroyed leaves
/// all viewports by itself; the interface is removed before it goes. A copied viewport shares them;
/// without memory the copy shows no handlers.
///
/// *Errors.* Nothing fails. Degenerate rectangles are absorbed where that is said, and give
/// infinities or NaN elsewhere; numbers that do not fit the device's integers become the nearest
/// ones that do.
class VORL_API GraphicViewPort {
 public:
  /// As after `Reset`, without handlers and interface.
  GraphicViewPort();
  /// The same, then `Init`.
  explicit GraphicViewPort(const Rect2D& areaAndWindow);
  GraphicViewPort(const Rect2D& area, const Rect2D& window);
  GraphicViewPort(const Rect2D& area, const Rect2D& window, const Rect2D& view);
  GraphicViewPort(const GraphicViewPort& source);
  GraphicViewPort& operator=(const GraphicViewPort& source);
  /// Takes the transformation from the handlers and resets the viewport, of which the interface
  /// still hears.
  virtual ~GraphicViewPort();

  /// View window, graphic window and graphic area (0, 0)-(100, 100), no borders, black, original
  /// scales 1, limits 0.1 and 10, modes free, no alignment; visible, proportional, clipped to the
  /// draw window, with a fixed graphic area, the mouse may scale and pan. Handlers and interface
  /// stay, the capture is released. Computes the transformation.
  virtual void Reset();
  /// Sets the graphic area, the graphic window and the view window.
  virtual void Init(Rect2D& area, Rect2D& window, Rect2D& view);
  /// Sets the pixels per graphic unit at scale 1, and the limits of the scales.
  virtual void SetScaleFactors(float origX, float origY, float minX, float maxX, float minY,
                               float maxY);
  /// The same by the sizes, in pixels, that the graphic area has at scale 1 and at the limits.
  virtual void SetScaleSizes(float origWidth, float origHeight, float minWidth, float maxWidth,
                             float minHeight, float maxHeight);
  /// Set the mode of one direction, of both when the viewport is proportional.
  virtual void FitWidth();
  virtual void FitHeight();
  /// Sets both modes, as the other functions named `Size` do.
  virtual void FitSize();
  virtual void OrigWidth();
  virtual void OrigHeight();
  virtual void OrigSize();
  virtual void MaxWidth();
  virtual void MaxHeight();
  virtual void MaxSize();
  virtual void MinWidth();
  virtual void MinHeight();
  virtual void MinSize();
  /// One `ViewAlignment` of each direction, added.
  virtual void SetAlignment(unsigned char alignment);
  /// False, whatever the flag says, while the view window or the graphic window has no area.
  virtual bool IsVisible();
  /// Null for none.
  virtual void SetInterface(IGraphicViewPort* viewPortInterface);
  /// Zooms by factors about the graphic reference position. A factor of 0 counts as 1; a direction
  /// whose factor is not 1 gets the mode free. Nothing is zoomed when one of the new scales, taken
  /// from the view window borders and all, would lie beyond its limits. Returns true. The
  /// transformation stays as it is.
  virtual bool DoScale(float factorX, float factorY);
  /// Shifts the graphic window by fractions of its size and computes the transformation. True.
  virtual bool DoPan(float fractionX, float fractionY);
  /// Shifts the view window by pixels and computes the transformation. True.
  virtual bool DoMove(float dx, float dy);

  /// As the virtual form, which they call; what is not given is the same rectangle, or stays.
  void Init(const Rect2D& areaAndWindow);
  void Init(const Rect2D& area, const Rect2D& window);
  void Init(const Rect2D& area, const Rect2D& window, const Rect2D& view);

  const Rect2D& GetGraphicArea() const;
  void GetGraphicArea(Rect2D& area) const;
  /// Sets the graphic area, and both modes to free.
  void SetGraphicArea(const Rect2D& area);
  void SetGraphicArea(const tagRECT& area);
  void SetGraphicArea(float left, float top, float right, float bottom);
  const Rect2D& GetGraphicWin() const;
  void GetGraphicWin(Rect2D& window) const;
  /// Sets the graphic window, and both modes to free.
  void SetGraphicWin(const Rect2D& window);
  void SetGraphicWin(const tagRECT& window);
  void SetGraphicWin(float left, float top, float right, float bottom);
  /// Shifts the graphic window.
  void MoveGraphicWin(float dx, float dy);
  void MoveGraphicWin(const dVect2D& way);
  /// Moves the top left corner of the graphic window to the point.
  void SetGraphicPos(const dVect2D& topLeft);
  void SetGraphicPos(const tagPOINT& topLeft);
  void SetGraphicPos(float x, float y);
  /// Moves the centre of the graphic window to that of the graphic area.
  void CenterWin(bool horizontally, bool vertically);

  const Rect2D& GetViewWin() const;
  void GetViewWin(Rect2D& view) const;
  /// The decimals are cut off.
  void GetViewWin(tagRECT& view) const;
  /// The sizes without their decimals.
  long GetViewWidth() const;
  long GetViewHeight() const;
  /// Change the view window, which is then normalised. Unless the width mode is fit, the graphic
  /// window becomes what the draw window shows under the present transformation: the viewport
  /// keeps its scale and shows more or less. `update` means nothing: `UpdateTransformation` is
  /// always left to the caller.
  void SetViewWin(const Rect2D& view, bool update);
  void SetViewWin(const tagRECT& view, bool update);
  void SetViewWin(float left, float top, float right, float bottom, bool update);
  void MoveViewWin(int dx, int dy, bool update);
  /// Moves the top left corner of the view window to the point.
  void SetViewPos(const tagPOINT& topLeft, bool update);
  void SetViewPos(int x, int y, bool update);
  /// The draw window in whole pixels: 0.5 is added to the edges of the view window and their
  /// decimals are cut off.
  void GetDrawWin(tagRECT& draw) const;
  /// The same rectangle as floats.
  void GetDrawWin(Rect2D& draw) const;
  /// Sets the borders, from 0 to 65535 pixels each; what is beyond becomes the nearest of these.
  void SetBorder(int left, int top, int right, int bottom);
  void SetBorder(int horizontal, int vertical);
  void SetBorder(int all);
  unsigned short GetTopBorder() const;
  unsigned short GetBottomBorder() const;
  unsigned short GetLeftBorder() const;
  unsigned short GetRightBorder() const;
  /// What `EraseBkgnd` fills the draw window and the border with (0x00bbggrr, in the lower 32
  /// bits).
  void SetBgColor(long color);
  void SetBorderColor(long color);
  long GetBgColor() const;
  long GetBorderColor() const;

  /// The scales of the transformation.
  float GetScaleX() const;
  float GetScaleY() const;
  /// Pixels per graphic unit at scale 1.
  double GetOrigSizeScaleX() const;
  double GetOrigSizeScaleY() const;
  double GetMinScaleX() const;
  double GetMinScaleY() const;
  double GetMaxScaleX() const;
  double GetMaxScaleY() const;
  /// The size of the graphic area, in pixels, at scale 1 and at the limits.
  double GetOrigSizeX() const;
  double GetOrigSizeY() const;
  double GetMinSizeX() const;
  double GetMinSizeY() const;
  double GetMaxSizeX() const;
  double GetMaxSizeY() const;

  /// Sets each mode (`ViewMode`), proportional or not.
  void SetViewMode(unsigned char widthMode, unsigned char heightMode);
  /// Set the mode of one direction, of both when the viewport is proportional.
  void SetWidthMode(unsigned char mode);
  void SetHeightMode(unsigned char mode);
  unsigned char GetWidthMode() const;
  unsigned char GetHeightMode() const;
  unsigned char GetAlignment() const;

  /// The flags (`ViewPortFlag`): replaces all of them, sets some, clears some.
  void SetMode(short flags);
  void Enable(short flags);
  void Disable(short flags);
  /// All of the given flags are set.
  bool IsEnabled(short flags) const;
  /// What the mouse may do, in each direction.
  void EnableScale(bool x, bool y);
  void EnablePan(bool x, bool y);
  void EnableMove(bool x, bool y);
  void SetProportional(bool proportional);
  void SetVisible(bool visible);
  void ClipBorders(bool clip);
  void SetFixedGraphicArea(bool fixed);

  /// Map from the device to graphic coordinates and back, in place or into `target`. Integers are
  /// mapped as the maps of the plane do: 0.5 is added first, the decimals are cut off in the end.
  void ViewToGraphic(tagPOINT& point) const;
  void ViewToGraphic(dVect2D& point) const;
  void ViewToGraphic(tagRECT& rect) const;
  void ViewToGraphic(Rect2D& rect) const;
  void ViewToGraphic(const tagPOINT& source, tagPOINT& target) const;
  void ViewToGraphic(const dVect2D& source, dVect2D& target) const;
  void ViewToGraphic(const tagRECT& source, tagRECT& target) const;
  void ViewToGraphic(const Rect2D& source, Rect2D& target) const;
  void GraphicToView(tagPOINT& point) const;
  void GraphicToView(dVect2D& point) const;
  void GraphicToView(tagRECT& rect) const;
  void GraphicToView(Rect2D& rect) const;
  void GraphicToView(const tagPOINT& source, tagPOINT& target) const;
  void GraphicToView(const dVect2D& source, dVect2D& target) const;
  void GraphicToView(const tagRECT& source, tagRECT& target) const;
  void GraphicToView(const Rect2D& source, Rect2D& target) const;
  TrafoST2D& GetTrafo();
  const TrafoST2D& GetTrafo() const;

  /// The point lies in the view window or on its edge.
  bool IsInside(const tagPOINT& point) const;
  bool IsInside(int x, int y) const;

  /// Set the point about which zooming goes, in view or in graphic coordinates; the other one
  /// follows by the present transformation.
  void SetViewRefPos(float x, float y);
  void SetGraphicRefPos(float x, float y);
  const dVect2D& GetViewRefPos() const;
  const dVect2D& GetGraphicRefPos() const;

  /// Where the graphic window stands in the scroll range, 0 at the left or top, 1 at the right or
  /// bottom; 0 when both have one size. The range is the graphic area, united with the graphic
  /// window unless the area is fixed.
  float GetScrollPosX() const;
  float GetScrollPosY() const;
  /// Move the graphic window there. Positions below 0 count as 0, those above 1 as 1; a window that
  /// is no smaller than the range stays.
  void SetScrollPos(float x, float y);
  void SetScrollPosX(float x);
  void SetScrollPosY(float y);
  /// How many times the range is as large as the graphic window.
  float GetScrollFactorX() const;
  float GetScrollFactorY() const;

  /// Computes the transformation from the graphic window and the view window.
  void UpdateTransformation();
  /// The same with a window, which comes back as it was sized and moved, and a view rectangle; they
  /// become the graphic window and the view window. Nothing happens when the view rectangle, or
  /// what the borders leave of it, has no width or height. A window without area is replaced by the
  /// graphic area, a graphic area without area by the draw window. All handlers lose the
  /// transformation, until they next draw or receive an event, and the interface is told.
  void UpdateTransformation(Rect2D& window, const Rect2D& view);

  /// Shows one handler (null for none) in place of those so far, which keep their transformation. A
  /// captured one still receives the mouse until the button is up.
  void SetGraphic(GraphicHandler* graphic);
  /// Shows a handler on top of the others; one that is shown already is moved to the top. False for
  /// null and without memory.
  bool AddGraphic(GraphicHandler* graphic);
  /// Removes a handler, or with null all of them; they lose their transformation and the capture.
  /// With no handlers at all, the transformation of the given one stays.
  void RemoveGraphic(GraphicHandler* graphic);

  /// Draws one handler, unless the viewport is not visible. The clip region is cut down to the draw
  /// window (without `ViewPortFlag_ClipBorders` to the view window) and to `clip`, if given, and
  /// stays so: the caller saves and restores the device context. When `clipIsGraphic` is set,
  /// `clip` is in graphic coordinates and is mapped to view coordinates in place.
  void Draw(HDC dc, GraphicHandler* graphic, Rect2D* clip, bool clipIsGraphic);
  /// The same with all handlers, the first added first.
  void Draw(HDC dc, Rect2D* clip, bool clipIsGraphic);
  /// Draws the captured handler's active object, clipped to the draw or the view window alone. The
  /// device context has no clip region afterwards.
  void DrawActiveObject(HDC dc);
  /// Fills the draw window and, if there is any border, the rest of the view window with their
  /// colours, unless the viewport is not visible. The clip region is cut down to the view window
  /// and to `clip` as in `Draw`, by a border also to the border.
  void EraseBkgnd(HDC dc, Rect2D* clip, bool clipIsGraphic);
  /// The captured handler's active object, or null.
  VGObjectView* GetActiveGraphicObject();

  /// Takes a mouse event (`MouseEvent`, flags `MK_LBUTTON` ..., a point of the device) and returns
  /// true when it was used. A button that goes down is offered to the handlers in turn; the one
  /// that takes it is captured and receives everything up to the next button up. When none takes
  /// it, the left button pans, with control moves the view window, with shift zooms about the
  /// point, as far as the flags allow. Events outside the view window count only during such an
  /// operation. Panning and moving compute the transformation; zooming leaves that to the caller,
  /// who calls `UpdateTransformation` and paints anew.
  bool ProcessMouseEvent(int event, int flags, tagPOINT point);
  /// Offers a key event to the handlers in turn; true when one takes it.
  bool ProcessKeyEvent(int event, int flags, int key);

 protected:
  /// The point lies in the rectangle; the right and bottom edges are outside.
  bool IsInside(int x, int y, const tagRECT& rect) const;
  bool IsInside(const tagPOINT& point, const tagRECT& rect) const;

  /// Scales the window about its centre to what modes and limits want when it fills `draw`; true
  /// when it changed. Proportional viewports get common limits, and the modes fit and original
  /// widen them to what they need.
  bool CorrectSize(Rect2D& window, const Rect2D& draw);
  /// Moves the window over the scroll range, or aligns it when the graphic window is larger than
  /// that; true when it moved.
  bool CorrectPosition(Rect2D& window) const;
  /// Widens the limits so that the scale at which `window` fills `view` is legal.
  void CorrectScaleLimits(const Rect2D& window, const Rect2D& view);

  /// Begin, go on with and end what the mouse does with the viewport itself; true when it does
  /// something.
  bool StartInteractiveOp(const tagPOINT& point, int flags);
  bool ProcessInteractiveOp(const tagPOINT& point);
  bool StopInteractiveOp(const tagPOINT& point);

 private:
  /// A handler; null once it is gone.
  class HandlerRef {
   public:
    HandlerRef() = default;
    explicit HandlerRef(const GraphicHandler& handler);
    GraphicHandler* Get() const { return m_life.lock().get(); }

   private:
    std::weak_ptr<GraphicHandler> m_life;
  };
  /// The handlers in the order of drawing. A copy for which there is no memory is empty.
  class HandlerList : public std::vector<HandlerRef> {
   public:
    HandlerList();
    HandlerList(const HandlerList& source);
    HandlerList& operator=(const HandlerList& source);
  };

  /// Not null, and in the list. Handlers may change that whenever they are called: what offers them
  /// something goes through a copy of the list, and asks this of each.
  bool IsShown(const GraphicHandler* handler) const;
  void Unlist(const GraphicHandler* handler);  ///< and those that are gone
  void TakeMapFromHandlers();                  ///< all that are shown lose the transformation
  void OnViewWinChanged();
  Rect2D ScrollRange() const;
  Rect2D WithoutBorders(const Rect2D& view) const;
  /// The view and the draw window as they are drawn, rounded alike.
  void GetDeviceWins(tagRECT& view, tagRECT& draw) const;
  void SetFlag(short flag, bool on);
  bool Pan(const tagPOINT& point);
  bool Move(const tagPOINT& point);
  bool Zoom(const tagPOINT& point);
  bool OfferButtonDown(int event, int flags, const tagPOINT& point);
  bool PassToCaptured(int event, int flags, tagPOINT& point);
  void ClipToWindow(HDC dc) const;
  void ClipTo(HDC dc, Rect2D* clip, bool clipIsGraphic) const;

  Rect2D m_graphicArea;
  Rect2D m_graphicWin;
  Rect2D m_viewWin;
  std::uint16_t m_topBorder = 0;
  std::uint16_t m_bottomBorder = 0;
  std::uint16_t m_leftBorder = 0;
  std::uint16_t m_rightBorder = 0;
  std::uint8_t m_widthMode = 0;
  std::uint8_t m_heightMode = 0;
  std::uint8_t m_alignment = 0;
  std::uint16_t m_mode = 0;       ///< `ViewPortFlag`
  std::uint16_t m_operation = 0;  ///< the flags of what the mouse is doing; 0 for nothing
  float m_origScaleX = 1.0F;
  float m_origScaleY = 1.0F;
  float m_minScaleX = 1.0F;
  float m_maxScaleX = 1.0F;
  float m_minScaleY = 1.0F;
  float m_maxScaleY = 1.0F;
  std::uint32_t m_bgColor = 0;
  std::uint32_t m_borderColor = 0;
  TrafoST2D m_trafo;
  tagPOINT m_startPoint{};  ///< where the operation began, or has come to
  tagPOINT m_moveOffset{};  ///< from the view window's corner to where a move began
  dVect2D m_viewRefPos;
  dVect2D m_graphicRefPos;
  HandlerList m_handlers;
  HandlerRef m_captured;
  IGraphicViewPort* m_interface = nullptr;
};

}  // namespace vorl

#endif
