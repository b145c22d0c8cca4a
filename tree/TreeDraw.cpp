// Drawing the rows, the grey wash of a busy pane and the scroll bars' ranges.

#include "GvTreeView.h"

#include <Bitmap.h>
#include <ScrollBar.h>
#include <Window.h>

#include <algorithm>
#include <cstring>

#include "FolderItem.h"
#include "Look.h"

namespace {
const rgb_color kBoxColor = { 80, 80, 80, 255 };
const rgb_color kBeBlue = { 0, 0, 255, 255 };
const rgb_color kBeRed = { 255, 0, 0, 255 };
const rgb_color kBlack = { 0, 0, 0, 255 };
}

float GvTreeView::_RowTop(int32 index)
{
	return 20 * index + 5;
}

BPoint GvTreeView::_RowOrigin(const FolderItem* item, int32 index)
{
	return BPoint(18 * item->level + 5, _RowTop(index));
}

int32 GvTreeView::_RowAt(float y)
{
	return y < 5 ? -1 : int32((y - 5) / 20);
}

void FolderItem::DrawItem(GvTreeView* view, BPoint where, int mode)
{
	if (mode != 0) {
		BRect bounds = view->Bounds();
		view->PushState();
		view->SetDrawingMode(B_OP_COPY);
		view->FillRect(BRect(bounds.left, where.y, bounds.right, where.y + GV_TREE_V_INT),
			B_SOLID_LOW);
		view->PopState();
	}
	view->MovePenTo(where);

	if (subdirCount > 0) {
		view->PushState();
		view->SetHighColor(kBoxColor);
		view->StrokeRect(BRect(where.x + GV_TREE_BOX_MIN, where.y + GV_TREE_BOX_MIN,
			where.x + GV_TREE_BOX_MAX, where.y + GV_TREE_BOX_MAX));
		view->StrokeLine(where + BPoint(5, 7), where + BPoint(9, 7));
		if (!expanded)
			view->StrokeLine(where + BPoint(7, 5), where + BPoint(7, 9));
		view->PopState();
	}
	view->MovePenBy(GV_TREE_BOX, 0);

	if (mode == 1) {
		BPoint corner = view->PenLocation();
		view->PushState();
		view->SetLowColor(GV_WASH);
		view->SetDrawingMode(B_OP_COPY);
		view->FillRect(BRect(corner, corner + BPoint(textWidth + GV_TREE_ICON, GV_TREE_V_INT)),
			B_SOLID_LOW);
		view->PopState();
	}
	view->DrawIcon(isVolume);
	view->MovePenBy(GV_TREE_ICON, GV_TREE_V_TEXT_START);

	float start = view->PenLocation().x;
	char label[B_FILE_NAME_LENGTH];
	GetName(label);
	if (std::strncmp(label, "Be", 2) == 0) {
		view->SetHighColor(kBeBlue);
		view->DrawString(label, 1);
		view->SetHighColor(kBeRed);
		view->DrawString(label + 1, 1);
		view->SetHighColor(kBlack);
		view->DrawString(label + 2);
	} else
		view->DrawString(label);
	textWidth = view->PenLocation().x - start + 2;
}

void GvTreeView::DrawIcon(bool volume)
{
	DrawBitmapAsync(volume ? volumeIcon.get() : folderIcon.get());
}

void GvTreeView::Draw(BRect update)
{
	int32 firstRow = std::max(int32((update.top - 5) / 20), int32(0));
	int32 lastRow = std::max(int32((update.bottom - 5) / 20), int32(0));
	if (firstRow > lastVisible)
		return;

	FolderItem* item = ItemAt(firstRow);
	for (int32 row = firstRow; row <= lastRow && item != NULL; row++) {
		item->DrawItem(this, _RowOrigin(item, row), item == selected ? 1 : 0);
		widestRow = std::max(widestRow, PenLocation().x);
		item = item->nextVisible;
	}
}

void GvTreeView::FrameResized(float width, float height)
{
	AdjustScrollBars(width, height);
}

void GvTreeView::AdjustScrollBars(float width, float height)
{
	if (horizontalBar != NULL) {
		float total = widestRow + 5;
		AdjustScrollBar(horizontalBar, total, width, total - width);
	}
	if (verticalBar != NULL) {
		float total = (lastVisible + 1) * 20 + 5;
		AdjustScrollBar(verticalBar, total, height, total - height);
	}
}

void GvTreeView::AdjustScrollBar(BScrollBar* bar, float total, float visible, float range)
{
	bar->SetRange(0, std::max(range, 0.0f));
	bar->SetProportion(total > 0 ? visible / total : 1.0f);
}

void GvTreeView::Disable(BRect area)
{
	if (enabled) {
		PushState();
		SetDrawingMode(B_OP_MAX);
		SetHighColor(GV_WASH);
		FillRect(area);
		PopState();
		if (Window() != NULL)
			Window()->UpdateIfNeeded();
	}
	enabled = false;
}

void GvTreeView::Enable(BRect area)
{
	Invalidate(area);
	if (Window() != NULL)
		Window()->UpdateIfNeeded();
	enabled = true;
}
