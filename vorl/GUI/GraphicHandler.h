#ifndef VORL_GUI_GRAPHICHANDLER_H
#define VORL_GUI_GRAPHICHANDLER_H

/// @file
/// One layer of graphic objects: drawing, selecting, creating, editing and deleting them.

#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/VGObjectView.h>
#include <vorl/Platform/Gdi.h>
#include <vorl/export.h>
#include <vorl/fwd.h>

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

inline namespace vorl {

/// What a handler is enabled for.
enum GraphicHandlerFlag : short {
  GraphicHandlerFlag_Visible = 1,      ///< is drawn and hit
  GraphicHandlerFlag_Interactive = 2,  ///< takes mouse events
  GraphicHandlerFlag_Default = 7       ///< both, and a bit for the application's own use
};

/// Learns what becomes of the objects of a handler. Nothing happens by default.
///
/// A call may delete any object from the handler, the one it is about included, but not destroy the
/// handler itself.
class VORL_API IGraphicHandler {
 public:
  /// A click has created an object.
  virtual void OnCreateObject(GraphicHandler* handler, VGObjectView* object);
  /// An object that the handler owns is about to be destroyed. It stands in no list any more.
  virtual void OnDeleteObject(GraphicHandler* handler, VGObjectView* object);
  /// A click has made an object the active one; null where it met none.
  virtual void OnSelectObject(GraphicHandler* handler, VGObjectView* object);
  /// A move of the mouse has changed the active object.
  virtual void OnModifyObject(GraphicHandler* handler, VGObjectView* object);
  /// The button was released, and the active object is changed.
  virtual void OnObjectModified(GraphicHandler* handler, VGObjectView* object);
  /// For the application's own events: the library raises none.
  virtual void GHEvent(GraphicHandler* handler, int event, VGObjectView* object);

  IGraphicHandler();
  IGraphicHandler(const IGraphicHandler& source);
  IGraphicHandler& operator=(const IGraphicHandler& source);
  // Behind the operations, which have the first places in the table of virtual functions.
  virtual ~IGraphicHandler();
};

/// An ordered list of objects, one of which may be active: it is drawn on top, and is the first to
/// be offered mouse events.
///
/// *Creating by click.* An application derives a handler that overrides `CreateObject`, and calls
/// `SetCreateMode`: the next left click on no object creates one.
///
/// *Ownership.* An object whose dynamic creation flag is set belongs to the handler and is
/// destroyed when it is deleted from it, and with it. Other objects are only taken from the list;
/// they keep the transformation that they had. The interface and the transformation stay the
/// caller's and must live as long as they are set.
///
/// *Callbacks.* Whatever the handler calls, of the interface or of an object, may add and delete
/// objects. One that is deleted while the handler goes through its list is not visited any more,
/// one that is added then is not yet.
class VORL_API GraphicHandler : public InputEventHandler {
 public:
  /// Without objects; visible and interactive.
  GraphicHandler();
  /// A handler that lists the same objects, of which it owns none: it takes them from its list, but
  /// does not destroy them. It has no transformation until it is given one. Without objects when
  /// there is no memory.
  GraphicHandler(const GraphicHandler& source);
  /// The same. Objects of this handler that the source does not list are deleted first; it goes on
  /// owning those that it owned and the source lists too.
  GraphicHandler& operator=(const GraphicHandler& source);
  /// Destroys the objects that it owns, without a word to the interface, which may be gone.
  ~GraphicHandler() override;

  using InputEventHandler::ProcessMouseEvent;
  /// Offers the event to the active object, then to this handler's own functions for it. True when
  /// one of them has used it. False unless visible and interactive.
  bool ProcessMouseEvent(int event, int flags, dVect2D& point) override;

 protected:
  /// Selects the object at the point and passes it the click; where there is none, creates one if
  /// that is wanted. True with an active object.
  bool OnMouseDownL(int flags, dVect2D& point) override;
  /// Selects the object at the point. True with an active object.
  bool OnMouseDownR(int flags, dVect2D& point) override;

 public:
  /// Draws the objects in list order, the active one last. Nothing unless visible.
  virtual void Draw(HDC dc, GraphicViewPort& viewPort);
  virtual void Draw(HDC dc);
  /// Draws the active object alone. Nothing unless visible.
  virtual void DrawActiveObject(HDC dc, GraphicViewPort& viewPort);
  virtual void DrawActiveObject(HDC dc);

  /// The first object in the list with this type and ID, this ID, or this user data. Null when
  /// there is none.
  virtual VGObjectView* GetObject(VGType type, long id);
  virtual VGObjectView* GetObject(long id);
  virtual VGObjectView* GetObjectByUserData(long data);
  /// Null when there is none.
  virtual VGObjectView* GetActiveObject();
  /// The first visible object in the list that the point, in view coordinates, lies on. The active
  /// one has no preference. Null when there is none, and unless visible.
  virtual VGObjectView* HitTest(dVect2D& point, int tolerance);

  /// Deletes the first object with this ID. False when there is none.
  virtual bool DeleteObject(long id);
  /// Deletes this object. False for null and with an empty list, else true: also for an object that
  /// is not in the list, which is left alone.
  virtual bool DeleteObject(VGObjectView* object);
  /// Deletes the objects of a type with an ID, of which -1 means any. An object of `VGType_None`
  /// counts as one of every type; `VGType_None` itself names such objects alone. False when there
  /// were none.
  virtual bool DeleteObjects(VGType type, long id);
  /// Deletes all objects; true.
  virtual bool DeleteAll();
  /// Deletes the selected objects. False when there were none.
  virtual bool DeleteSelected();
  /// Deletes the active object. False when there is none.
  virtual bool DeleteActive();

  /// The corners of the rectangle around the boxes of all objects, visible or not, in view
  /// coordinates; both (0, 0) without objects.
  virtual void CalcBoundingBox(HDC dc, dVect2D& min, dVect2D& max);
  /// Makes an object of the given type for a click, with its dynamic creation flag set if the
  /// handler shall own it. Null for none, as always here.
  virtual VGObjectView* CreateObject(VGType type);
  /// Gives an object the handler's transformation and appends it to the list. An object may stand
  /// in it several times. False for null, for an object that the handler is just destroying, and
  /// without memory.
  virtual bool AddObject(VGObjectView* object);

 protected:
  /// Makes the last object in the list that the mouse grabs at the point the active one. All that
  /// it grabs are selected. True with an active object; false unless visible and interactive.
  virtual bool SelectObject(int flags, dVect2D& point);

 public:
  /// For literals, of which 0 could else be taken for a null pointer.
  bool DeleteObject(int id) { return DeleteObject(static_cast<long>(id)); }

  void SetInterface(IGraphicHandler* client);
  /// Sets the map from graphic (A) to view coordinates (B) and gives it to all objects. Null for
  /// none. The map that is set already changes nothing.
  void SetTransformation(Trafo2DBase* trafo);
  /// What the next left click on no object creates, `VGType_None` for nothing, and the ID that the
  /// next created object gets, -1 for its own.
  void SetCreateMode(VGType type, long id);

  /// Set, clear and ask flags (`GraphicHandlerFlag`).
  void Enable(short flags);
  void Disable(short flags);
  /// All of these flags are set.
  bool IsEnabled(short flags) const;

  /// The units in which values along the axes are shown.
  void SetUnitTrafo(const UnitTrafo& x, const UnitTrafo& y);
  UnitTrafo& GetUnitTrafoX();
  const UnitTrafo& GetUnitTrafoX() const;
  UnitTrafo& GetUnitTrafoY();
  const UnitTrafo& GetUnitTrafoY() const;
  /// Select a unit, 0 to 3 (see `UnitTrafo`).
  void SelectUnitX(int unit);
  void SelectUnitY(int unit);

 private:
  friend class GraphicViewPort;
  friend class VGObjectView;

  /// A place in the list. One whose object is deleted during a walk is empty until it ends.
  struct Entry {
    VGObjectView* object;
    bool isBorrowed;  ///< another handler's, that this one was copied from
  };
  class Walk;
  class Doomed;

  bool IsInteractive() const;
  void DrawObjects(HDC dc, GraphicViewPort* viewPort);
  bool CreateByClick(int flags, dVect2D& point);
  void NotifySelection();

  bool IsEmpty() const;
  bool IsListed(const VGObjectView* object) const;
  bool Owns(const VGObjectView* object) const;
  bool IsRegistered(const VGObjectView* object) const;
  bool IsDoomed(const VGObjectView* object) const;
  template <typename Predicate>
  VGObjectView* Find(Predicate predicate);
  template <typename Predicate>
  bool DeleteWhere(Predicate predicate);
  bool Append(VGObjectView* object, bool isBorrowed);
  void Delete(std::size_t index);
  void ClearEntries(const VGObjectView* object);
  void CopyState(const GraphicHandler& source);
  bool CopyList(const GraphicHandler& source);
  bool Register(VGObjectView* object);
  void Unregister(VGObjectView* object);
  /// For those who want to know when this handler goes. False without memory.
  bool StartLife();
  /// An object is gone, by whatever hand.
  void Forget(VGObjectView* object);

  std::uint16_t m_flags = GraphicHandlerFlag_Default;
  std::vector<Entry> m_list;
  VGObjectView* m_pActive = nullptr;
  VGType m_createMode = VGType_None;
  long m_createID = -1;
  Trafo2DBase* m_pTrafo = nullptr;
  UnitTrafo m_unitTrafoX;
  UnitTrafo m_unitTrafoY;
  IGraphicHandler* m_pInterface = nullptr;
  std::size_t m_walks = 0;                 ///< walks through the list that are under way
  bool m_mayRepeat = false;                ///< some object was listed more than once
  std::vector<VGObjectView*> m_doomed;     ///< those that are just being destroyed, by this handler
  std::shared_ptr<GraphicHandler> m_life;  ///< owns nothing; viewports see by it that this is there
};

}  // namespace vorl

#endif
