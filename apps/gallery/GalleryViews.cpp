#include "GalleryViews.h"

#include <algorithm>
#include <cmath>

#include "tarsel/Localizer.h"
#include "ui/MouseEvent.h"
#include "ui/UI_NodeManager.h"
#include "ui/Theme.h"

namespace norvik::gallery {

namespace {

const unsigned short* U16(const UTF16String& inText) { return reinterpret_cast<const unsigned short*>(inText.c_str()); }

}  // namespace

void AddGalleryChild(ui::UI_Node* inParent, const ui::UI_NodeP& inChild) {
  inChild->UI_SetIndex(static_cast<int>(inParent->ChildSize()));
  inChild->UI_Show(true);
  inParent->ChildPushBack(inChild);
}

// ---- SectionView ----

SectionView::SectionView(std::string inTitleKey) : mTitle(Text(inTitleKey)) {}

RectF SectionView::ContentRect() const {
  const RectF r = UI_GetLocalRectF(false);
  return RectF(kPadding, kHeadingHeight, std::max(0.0f, r.width - 2 * kPadding),
               std::max(0.0f, r.height - kHeadingHeight - kPadding));
}

void SectionView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  FillRoundRect(inDrawbot, r, 5, c.panel);
  StrokeRoundRect(inDrawbot, r, 5, c.border, 1);
  DrawLabel(inDrawbot, mTitle, RectF(kPadding, 0, r.width - 2 * kPadding, kHeadingHeight), c.text,
            drawbot::kTextAlignLeft, 0, true);
  FillRect(inDrawbot, RectF(kPadding, kHeadingHeight - 5, r.width - 2 * kPadding, 1), Mix(c.panel, c.border, 0.7f));
  UI_SubView::UI_Draw(inDrawbot);
}

// ---- SwatchView ----

SwatchView::SwatchView() { UI_SetNodeID("swatches"); }

void SwatchView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  struct Role {
    const char* key;
    ColorRGBA color;
  };
  const Role roles[] = {
      {"$$$/norvik/gallery/Swatch/Background=Background", c.background},
      {"$$$/norvik/gallery/Swatch/Panel=Panel", c.panel},
      {"$$$/norvik/gallery/Swatch/Header=Header", c.header},
      {"$$$/norvik/gallery/Swatch/Text=Text", c.text},
      {"$$$/norvik/gallery/Swatch/Border=Border", c.border},
      {"$$$/norvik/gallery/Swatch/Accent=Accent", c.accent},
      {"$$$/norvik/gallery/Swatch/Hover=Hover", c.hover},
      {"$$$/norvik/gallery/Swatch/Secondary=Secondary text", c.dimText},
  };
  const int columns = 4;
  const float gap = 8;
  const float cellW = (r.width - gap * (columns - 1)) / columns;
  const float chipH = 26, labelH = 18;
  int i = 0;
  for (const Role& role : roles) {
    const float x = (i % columns) * (cellW + gap);
    const float y = (i / columns) * (chipH + labelH + 6);
    const RectF chip(x, y, cellW, chipH);
    FillRoundRect(inDrawbot, chip, 3, role.color);
    StrokeRoundRect(inDrawbot, chip, 3, c.border, 1);
    DrawLabel(inDrawbot, Text(role.key), RectF(x, y + chipH, cellW, labelH), c.dimText);
    ++i;
  }
  // The palette as the theme answers it at its current brightness.
  const float stripTop = 2 * (chipH + labelH + 6) + 4;
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Swatch/Palette=Palette entries 0 to 31"),
            RectF(0, stripTop, r.width, labelH), c.dimText);
  const float cell = std::floor((r.width - 15) / 16);
  for (int id = 0; id < kPaletteStrip; ++id) {
    const float x = (id % 16) * (cell + 1);
    const float y = stripTop + labelH + 4 + (id / 16) * (cell * 0.6f + 1);
    const RectF chip(x, y, cell, std::floor(cell * 0.6f));
    FillRect(inDrawbot, chip, c.panel);
    FillRect(inDrawbot, chip, ui::GetColor(static_cast<std::uint64_t>(id)));
  }
}

// ---- DrawingSamplesView ----

DrawingSamplesView::DrawingSamplesView() { UI_SetNodeID("drawing"); }

void DrawingSamplesView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  auto* surface = inDrawbot->GetSurface();
  const auto* supplier = inDrawbot->GetSupplier();
  const float cellW = (r.width - 16) / 3, cellH = 70;

  // Lines: widths, caps and a dash pattern.
  for (int i = 0; i < 4; ++i) {
    drawbot::PenP pen(supplier, c.text, 1.0f + i);
    if (i == 3) {
      const float dashes[] = {6, 4};
      pen->SetDashArray(dashes, 2);
      pen->SetWidth(2);
    }
    pen->SetLineCap(i == 2 ? drawbot::kLineCapRound : drawbot::kLineCapFlat);
    drawbot::PathP line(supplier);
    const float y = 10.5f + i * 14;
    line->MoveTo(PointF(6, y));
    line->LineTo(PointF(cellW - 6, y));
    surface->StrokePath(*pen, *line);
  }

  // A curve over a filled triangle.
  const float x1 = cellW + 8;
  drawbot::PathP tri(supplier);
  tri->MoveTo(PointF(x1 + 10, cellH - 4));
  tri->LineTo(PointF(x1 + cellW / 2, 6));
  tri->LineTo(PointF(x1 + cellW - 10, cellH - 4));
  tri->ClosePath();
  drawbot::BrushP triBrush(supplier, Mix(c.panel, c.accent, 0.35f));
  surface->FillPath(*triBrush, *tri, drawbot::kFillWinding);
  drawbot::PathP curve(supplier);
  curve->MoveTo(PointF(x1 + 4, cellH / 2));
  curve->BezierTo(PointF(x1 + cellW * 0.3f, -10), PointF(x1 + cellW * 0.6f, cellH + 10),
                  PointF(x1 + cellW - 4, cellH / 2));
  drawbot::PenP curvePen(supplier, c.accent, 2.5f);
  surface->StrokePath(*curvePen, *curve);

  // A gradient in a rounded frame and a ring of dots.
  const float x2 = 2 * (cellW + 8);
  const RectF grad(x2, 4, cellW, cellH - 8);
  drawbot::LinearShaderP shader(supplier, PointF(grad.left, 0), PointF(grad.left + grad.width, 0), c.accent, c.panel);
  drawbot::PathP gradPath(supplier);
  gradPath->AddRect(grad);
  surface->ShadePath(*shader, *gradPath, drawbot::kFillWinding);
  StrokeRoundRect(inDrawbot, grad, 0, c.border, 1);
  drawbot::BrushP dot(supplier, c.text);
  for (int i = 0; i < 8; ++i) {
    const float a = static_cast<float>(i) * 3.14159265f / 4;
    drawbot::PathP p(supplier);
    const PointF centre(grad.left + grad.width * 0.7f + 16 * std::cos(a), grad.top + grad.height / 2 + 16 * std::sin(a));
    p->MoveTo(PointF(centre.x + 1.5f + i * 0.25f, centre.y));
    p->AddArc(centre, 1.5f + i * 0.25f, 0, 360);
    p->ClosePath();
    surface->FillPath(*dot, *p, drawbot::kFillWinding);
  }

  // Text, aligned three ways, and a long line cut with an ellipsis.
  const float ty = cellH + 10;
  const RectF box(0, ty, r.width, 22);
  FillRect(inDrawbot, box, Mix(c.panel, c.background, 0.5f));
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Drawing/Left=Left"), RectF(6, ty, r.width - 12, 22), c.text);
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Drawing/Centre=Centred"), RectF(6, ty, r.width - 12, 22), c.text,
            drawbot::kTextAlignCenter);
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Drawing/Right=Right"), RectF(6, ty, r.width - 12, 22), c.text,
            drawbot::kTextAlignRight);
  DrawLabel(inDrawbot,
            Text("$$$/norvik/gallery/Drawing/Long=A label too long for its place ends with an ellipsis instead of "
                 "running over its neighbours"),
            RectF(6, ty + 26, r.width * 0.6f, 20), c.dimText);
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Drawing/Large=Timeline 00:01:24:12"), RectF(6, ty + 48, r.width - 12, 26),
            c.text, drawbot::kTextAlignLeft, 16, true);
}

// ---- HoverBoxView and NodeTreeView ----

HoverBoxView::HoverBoxView(std::string inLabelKey, int inDepth) : mLabel(Text(inLabelKey)), mDepth(inDepth) {}

void HoverBoxView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  const bool leaf = UI_IsMouseOver(true);
  const bool onChain = UI_IsMouseOver(false);
  const ColorRGBA base = Mix(c.panel, c.text, 0.05f * static_cast<float>(mDepth));
  FillRoundRect(inDrawbot, r, 4, leaf ? c.hover : base);
  StrokeRoundRect(inDrawbot, r, 4, onChain ? c.accent : c.border, onChain ? 2.0f : 1.0f);
  DrawLabel(inDrawbot, mLabel, RectF(8, 2, r.width - 16, 20), leaf ? c.text : c.dimText);
  UI_SubView::UI_Draw(inDrawbot);
}

NodeTreeView::NodeTreeView() {
  UI_SetNodeID("node-tree");
  static const char* const outerKeys[] = {"$$$/norvik/gallery/Tree/Sequence=Sequence",
                                          "$$$/norvik/gallery/Tree/Mixer=Mixer"};
  static const char* const innerKeys[][3] = {
      {"$$$/norvik/gallery/Tree/Video=Video 1", "$$$/norvik/gallery/Tree/Video2=Video 2",
       "$$$/norvik/gallery/Tree/Titles=Titles"},
      {"$$$/norvik/gallery/Tree/Dialogue=Dialogue", "$$$/norvik/gallery/Tree/Music=Music",
       "$$$/norvik/gallery/Tree/Master=Master"}};
  for (int o = 0; o < 2; ++o) {
    ui::UI_NodeP outer(new HoverBoxView(outerKeys[o], 1));
    outer->UI_SetNodeID(o == 0 ? "sequence" : "mixer");
    AddGalleryChild(this, outer);
    mOuter.push_back(outer);
    mInner.emplace_back();
    for (int i = 0; i < 3; ++i) {
      ui::UI_NodeP inner(new HoverBoxView(innerKeys[o][i], 2));
      AddGalleryChild(outer.get(), inner);
      mInner.back().push_back(inner);
    }
  }
}

void NodeTreeView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void NodeTreeView::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const float hintH = 22, gap = 10;
  const float outerW = (r.width - gap) / 2, outerH = std::max(0.0f, r.height - hintH);
  for (std::size_t o = 0; o < mOuter.size(); ++o) {
    mOuter[o]->UI_SetLocalRectF(RectF(static_cast<float>(o) * (outerW + gap), hintH, outerW, outerH));
    const float innerTop = 26, innerH = (outerH - innerTop - 8 - 2 * 6) / 3;
    for (std::size_t i = 0; i < mInner[o].size(); ++i)
      mInner[o][i]->UI_SetLocalRectF(
          RectF(8, innerTop + static_cast<float>(i) * (innerH + 6), std::max(0.0f, outerW - 16), std::max(0.0f, innerH)));
  }
}

void NodeTreeView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Tree/Hint=Move the mouse over the boxes: each is a node."),
            RectF(0, 0, r.width, 18), c.dimText);
  UI_SubView::UI_Draw(inDrawbot);
}

// ---- FocusTileView and FocusDemoView ----

FocusTileView::FocusTileView(std::string inLabelKey) : mLabel(Text(inLabelKey)) {}

bool FocusTileView::UI_DoMouseEvent(ui::UI_Node*, const ui::MouseEvent& inEvent) {
  if (!inEvent.IsAction(ui::MouseEvent::kActionButtonDown)) return false;
  UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  return true;
}

void FocusTileView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  const bool focused = UI_HasKeyboardFocus(true);
  const bool over = UI_IsMouseOver(true);
  const RectF tile(3, 3, r.width - 6, r.height - 6);
  FillRoundRect(inDrawbot, tile, 4, over ? c.hover : Mix(c.panel, c.text, 0.07f));
  StrokeRoundRect(inDrawbot, tile, 4, c.border, 1);
  if (focused) StrokeRoundRect(inDrawbot, r, 6, c.accent, 2);
  DrawLabel(inDrawbot, mLabel, tile, focused ? c.text : c.dimText, drawbot::kTextAlignCenter, 0, focused);
}

FocusDemoView::FocusDemoView() {
  UI_SetNodeID("focus-demo");
  static const char* const keys[kTileCount] = {
      "$$$/norvik/gallery/Focus/Source=Source", "$$$/norvik/gallery/Focus/Program=Program",
      "$$$/norvik/gallery/Focus/Timeline=Timeline", "$$$/norvik/gallery/Focus/Effects=Effects"};
  for (const char* key : keys) AddGalleryChild(this, ui::UI_NodeP(new FocusTileView(key)));
}

void FocusDemoView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void FocusDemoView::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const float gap = 8, top = 24;
  const float w = (r.width - gap * (kTileCount - 1)) / kTileCount;
  const float h = std::min(std::max(0.0f, r.height - top), 56.0f);
  int i = 0;
  for (auto it = ChildBegin(); it != ChildEnd(); ++it, ++i) {
    (*it)->UI_SetLocalRectF(RectF(std::floor(i * (w + gap)), top, std::floor(w), h));
  }
}

void FocusDemoView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  DrawLabel(inDrawbot,
            Text("$$$/norvik/gallery/Focus/Hint=Click a tile or press Tab and Shift+Tab to move the focus."),
            RectF(0, 0, r.width, 18), c.dimText);
  UI_SubView::UI_Draw(inDrawbot);
}

// ---- HeaderView ----

HeaderView::HeaderView() { UI_SetNodeID("header"); }

void HeaderView::SetSubtitle(const UTF16String& inSubtitle) {
  if (mSubtitle == inSubtitle) return;
  mSubtitle = inSubtitle;
  UI_Invalidate(nullptr, 0);
}

void HeaderView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  FillRect(inDrawbot, r, c.header);
  FillRect(inDrawbot, RectF(0, r.height - 1, r.width, 1), Mix(c.header, c.border, 0.8f));
  FillRoundRect(inDrawbot, RectF(14, (r.height - 18) / 2, 18, 18), 4, c.accent);
  const UTF16String title = Text("$$$/norvik/gallery/Title=norvik gallery");
  drawbot::FontP bold = LabelFont(inDrawbot, 15, true);
  float titleW = 120;
  if (bold)
    titleW = inDrawbot->GetSurface()->MeasureStringWidth(*bold, U16(title), static_cast<long>(title.size()));
  DrawLabel(inDrawbot, title, RectF(42, 0, titleW + 4, r.height), c.text, drawbot::kTextAlignLeft, 15, true);
  DrawLabel(inDrawbot, mSubtitle,
            RectF(42 + titleW + 16, 0, std::max(0.0f, r.width - titleW - 58 - 180), r.height), c.dimText);
  UI_SubView::UI_Draw(inDrawbot);
}

// ---- BrightnessSwitch ----

BrightnessSwitch::BrightnessSwitch() { UI_SetNodeID("brightness-switch"); }

void BrightnessSwitch::SetLight(bool inLight) {
  if (mLight == inLight) return;
  mLight = inLight;
  UI_Invalidate(nullptr, 0);
}

bool BrightnessSwitch::UI_DoMouseEvent(ui::UI_Node*, const ui::MouseEvent& inEvent) {
  if (!inEvent.IsAction(ui::MouseEvent::kActionButtonDown)) return false;
  ui::UI_NodeP self(this);
  UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  Toggle();
  return true;
}

bool BrightnessSwitch::UI_DoKeyboardEvent(ui::UI_Node*, const ui::KeyboardEvent& inEvent) {
  if (!ui::UI_NodeManager::CompareControlActivateShortcut(inEvent)) return false;
  if (inEvent.IsActionKeyDown()) Toggle();
  return true;
}

void BrightnessSwitch::Toggle() {
  SetLight(!mLight);
  // The change function may rebuild or repaint the page; keep this node
  // alive until it returns.
  ui::UI_NodeP self(this);
  if (mChange) mChange(mLight);
}

// A switch named after what it turns on: on is the light look, whichever
// look is showing, so the label never reads as a state and an action at once.
void BrightnessSwitch::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  const float trackW = 38, trackH = 20;
  const RectF track(r.width - trackW - 3, (r.height - trackH) / 2, trackW, trackH);
  FillRoundRect(inDrawbot, track, trackH / 2, mLight ? c.accent : Mix(c.header, c.text, 0.25f));
  if (UI_IsMouseOver(true)) StrokeRoundRect(inDrawbot, track, trackH / 2, c.text, 1);
  if (UI_HasKeyboardFocus(true))
    StrokeRoundRect(inDrawbot, RectF(track.left - 3, track.top - 3, trackW + 6, trackH + 6), trackH / 2 + 3, c.accent,
                    2);
  const float knob = trackH - 6;
  const RectF knobRect(mLight ? track.left + trackW - knob - 3 : track.left + 3, track.top + 3, knob, knob);
  FillRoundRect(inDrawbot, knobRect, knob / 2, ColorRGBA(0.97f, 0.97f, 0.97f, 1));
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Switch/LightLook=Light look"),
            RectF(0, 0, track.left - 8, r.height), c.text, drawbot::kTextAlignRight);
}

}  // namespace norvik::gallery
