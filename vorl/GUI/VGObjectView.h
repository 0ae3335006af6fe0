#ifndef VORL_GUI_VGOBJECTVIEW_H
#define VORL_GUI_VGOBJECTVIEW_H

/// @file
/// The base of everything that a `GraphicHandler` shows: identity, look, state, and the machine
/// that turns mouse events into operations on the object.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/Trafo2D.h>
#include <vorl/Platform/Gdi.h>
#include <vorl/export.h>
#include <vorl/fwd.h>

#include <cstdint>
#include <vector>

inline namespace vorl {

/// What kind of object a view shows. 5 and 6 are not used.
enum VGType : int {
  VGType_None = 0,  ///< no object; as a create mode: nothing to create
  VGType_Point = 1,
  VGType_Line = 2,
  VGType_Rect = 3,
  VGType_Bitmap = 4,
  VGType_Text = 7,
  VGType_Axis = 8,
  VGType_Curve = 9,
  VGType_CrossCursor = 10
};

/// Operations on an object with the mouse: what a view is enabled for, and its operation state.
enum VGOperation : short {
  VGOperation_None = 0,
  VGOperation_Create = 1,
  VGOperation_Select = 2,  ///< the mouse can grab the object at all; no operation by itself
  VGOperation_Modify = 4,
  VGOperation_Move = 8,
  VGOperation_Resize = 16,
  VGOperation_Rotate = 32,
  VGOperation_All = 0x3F
};

/// The bits of the view state.
enum VGViewState : short { VGViewState_Selected = 1, VGViewState_Visible = 2 };

/// The base of the classes that hold the geometry of an object.
class VORL_API VGObject {
 public:
  VGObject();
  VGObject(const VGObject& source);
  VGObject& operator=(const VGObject& source);
  virtual ~VGObject();
};

/// Learns what the mouse does with an object. Nothing happens by default.
///
/// A call may remove the object from its handler, and so destroy it.
class VORL_API IVGObjectView {
 public:
  /// An operation (`VGOperation`) was begun, carried on, or ended. Creation itself is not reported
  /// here, but to `IGraphicHandler::OnCreateObject`.
  virtual void OnBeginGraphicOp(VGObjectView* object, short operation);
  virtual void OnGraphicChanged(VGObjectView* object, short operation);
  virtual void OnEndGraphicOp(VGObjectView* object, short operation);

  IVGObjectView();
  IVGObjectView(const IVGObjectView& source);
  IVGObjectView& operator=(const IVGObjectView& source);
  // Behind the operations, which have the first places in the table of virtual functions.
  virtual ~IVGObjectView();
};

/// One object of a `GraphicHandler`.
///
/// *Frame.* The geometry is held twice: in graphic coordinates, in which the application knows it,
/// and in view coordinates, in which it is drawn, hit and dragged. `Transform` leads from one to
/// the other. Points of mouse events, tolerances and bounding boxes are in view coordinates.
///
/// *State.* A view starts invisible, with no operation allowed. Made visible with `SetViewState`
/// it is shown; left invisible, with creation allowed, its first left click creates it. Selected
/// objects are drawn with their handles.
///
/// *Ownership.* The interface and the transformation stay the caller's and must live as long as
/// they are set. An object that is destroyed leaves the lists of all its handlers by itself. What
/// it calls of its own, to draw or to take an event, may destroy it.
class VORL_API VGObjectView {
 public:
  virtual ~VGObjectView();

  virtual VGType GetObjType() = 0;
  /// Sets the map from graphic (A) to view coordinates (B) and refreshes the view's geometry
  /// (`Transform(false)`). Null: the identity, one `Translate2D` that all objects share.
  virtual void SetTransformation(Trafo2DBase* trafo);
  /// False: makes the view's geometry from that in graphic coordinates. True: the way back.
  virtual void Transform(bool toGraphic) = 0;
  /// The point lies on the object, to within a tolerance. False here.
  virtual bool IsPointOnGraphic(tagPOINT& point, int tolerance);
  virtual bool IsPointOnGraphic(dVect2D& point, int tolerance);
  /// The operation (`VGOperation`) for which the mouse grabs the object at a point; 0, as always
  /// here, where it does not. The flags are the mouse keys (`MK_LBUTTON` ...).
  virtual short GetSelectionState(int flags, tagPOINT& point);
  virtual short GetSelectionState(int flags, dVect2D& point);
  /// Takes a mouse event (`MouseEvent`) with its mouse keys. True when the object has used it.
  ///
  /// 1. A left click on an object with the view state 0, which creation is allowed for, makes it
  ///    visible and begins its creation.
  /// 2. An invisible object takes no events.
  /// 3. A left click begins the operation that `GetSelectionState` names. Where that is not
  ///    allowed, the object is moved instead, if that is.
  /// 4. The handler of the operation is called, the interface told, and the handler's result
  ///    returned. It is the handlers that end an operation.
  virtual bool ProcessMouseEvent(int event, int flags, tagPOINT& point);
  virtual bool ProcessMouseEvent(int event, int flags, dVect2D& point);
  /// Draws a visible object: `DrawGraphic`, and then `DrawSelection` when it is selected.
  virtual void Draw(HDC dc, GraphicViewPort& viewPort);
  virtual void Draw(HDC dc);
  /// Draw the object, and its handles. Nothing here; the forms with a viewport call those without.
  virtual void DrawGraphic(HDC dc, GraphicViewPort& viewPort);
  virtual void DrawGraphic(HDC dc);
  virtual void DrawSelection(HDC dc, GraphicViewPort& viewPort);
  virtual void DrawSelection(HDC dc);
  /// Sets the pen (a device style such as `PS_SOLID`, a width in device units, a colour
  /// 0x00bbggrr) and the binary raster operation (`R2_COPYPEN` ...).
  virtual void SetDrawParams(int style, int thickness, int color, int rop);
  virtual void SetPenStyle(int style);
  virtual void SetPenThickness(int thickness);
  virtual void SetPenColor(int color);
  virtual void SetROPMode(int rop);
  /// The corners of the object's bounding box in view coordinates.
  virtual void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max) = 0;

  /// The handlers of the operations; false here. One that ends an operation resets its state.
  virtual bool OnCreate(int event, int flags, dVect2D& point);
  virtual bool OnBeginMove(dVect2D& point);
  virtual bool OnMove(dVect2D& point);
  virtual bool OnEndMove(dVect2D& point);
  virtual bool OnBeginResize(dVect2D& point);
  virtual bool OnResize(dVect2D& point);
  virtual bool OnEndResize(dVect2D& point);
  virtual bool OnBeginModify(dVect2D& point);
  virtual bool OnModify(dVect2D& point);
  virtual bool OnEndModify(dVect2D& point);
  virtual bool OnBeginRotate(dVect2D& point);
  virtual bool OnRotate(dVect2D& point);
  virtual bool OnEndRotate(dVect2D& point);
  /// An operation has edited the view's geometry: writes it back (`Transform(true)`).
  virtual void ViewDataChanged();

  void SetInterface(IVGObjectView* client);
  IVGObjectView* GetInterface() const;
  /// The map in use, never null.
  Trafo2DBase* GetTransformation() const;

  /// Identifies the object. By default the number is the object's address.
  void SetObjID(long id);
  long GetObjID() const;
  /// A number of the application's own, 0 by default.
  void SetUserData(long data);
  long GetUserData() const;

  /// Sets bits of the view state (`VGViewState`); the others stay.
  void SetViewState(short bits);
  /// Clears bits of the view state; the others stay.
  void ResetViewState(short bits);
  void Select(bool select);
  bool IsSelected() const;
  bool IsVisible() const;

  /// Allow and forbid operations (bits of `VGOperation`).
  void Enable(short bits);
  void Disable(short bits);
  /// All of these bits are set.
  bool IsEnabled(short bits) const;
  /// The running operation (`VGOperation`).
  short GetOpState() const;

  int GetPenStyle() const;
  int GetPenThickness() const;
  int GetPenColor() const;
  int GetROPMode() const;

  /// How far from a line, and from a handle, a click still hits, in device units; 2 and 4 by
  /// default.
  void SetSelectionDistances(unsigned char line, unsigned char handle);

  /// Gives the object, which must have been created with `new`, into the hands of its handler,
  /// which destroys it when it is deleted there.
  void SetDynamicCreationFlag();
  bool IsDynamicCreated() const;

 protected:
  VGObjectView();
  /// A copy is in no handler's list, is not dynamically created, and has an ID of its own where
  /// the source's is its address. All else is equal.
  VGObjectView(const VGObjectView& source);
  /// The same; the lists that this object stands in, whether it was dynamically created, and its
  /// transformation, which goes with its place, stay.
  VGObjectView& operator=(const VGObjectView& source);

  /// Lowers `min` and raises `max` in each component, so that both enclose the point.
  void UpdateBoundingBox(const dVect2D& point, dVect2D& min, dVect2D& max);

  /// For the handlers of the operations.
  void SetOpState(short operation);
  /// Makes these bits the whole view state.
  void AssignViewState(short bits);
  int GetLineDistance() const;
  int GetHandleDistance() const;

 private:
  friend class GraphicHandler;

  class Watch;

  long DefaultID() const;
  void CopyLook(const VGObjectView& source);
  bool Dispatch(int event, int flags, dVect2D& point);

  std::uint16_t m_enableFlags = 0;
  std::uint16_t m_opState = VGOperation_None;
  std::uint16_t m_viewState = 0;
  long m_objID;
  long m_userData = 0;
  IVGObjectView* m_pInterface = nullptr;
  Trafo2DBase* m_pTrafo;
  int m_penStyle = PS_SOLID;
  int m_penThickness = 1;
  int m_penColor = 0;
  int m_ropMode = R2_COPYPEN;
  std::uint8_t m_lineDistance = 2;
  std::uint8_t m_handleDistance = 4;
  std::vector<GraphicHandler*> m_handlers;  ///< whose lists hold this object
  Watch* m_watch = nullptr;                 ///< the last one that waits for the object's end
};

}  // namespace vorl

#endif
