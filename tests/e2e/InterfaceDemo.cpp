// A window that exercises the drawing of the Interface Kit, for the
// end-to-end check that the SDL backend shows exactly what the headless one
// draws.
//   interface_demo                run it (quit with Escape)
//   interface_demo --dump PATH    headless: write the window's pixels to PATH
//                                 as raw RGB rows and quit

#include <cstdio>
#include <cstring>
#include <vector>

#include <Application.h>
#include <Bitmap.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

#include "Headless.h"
#include "SystemPalette.h"

namespace {

const BRect kFrame(40, 30, 359, 229);

class DemoView : public BView {
public:
	DemoView()
		:
		BView(kFrame.OffsetToCopy(0, 0), "demo", B_FOLLOW_ALL_SIDES, B_WILL_DRAW),
		fIcon(BRect(0, 0, 15, 15), B_CMAP8)
	{
		SetViewColor(205, 205, 205);
		// A black ring on a transparent field, blue in the middle.
		std::vector<uint8> bits(fIcon.BitsLength(), B_TRANSPARENT_MAGIC_CMAP8);
		for (int32 y = 0; y < 16; y++) {
			for (int32 x = 0; x < 16; x++) {
				int32 distance = (x - 8) * (x - 8) + (y - 8) * (y - 8);
				if (distance < 20)
					bits[y * fIcon.BytesPerRow() + x] = BPrivate::IndexForColor(0, 0, 255);
				else if (distance < 40)
					bits[y * fIcon.BytesPerRow() + x] = BPrivate::IndexForColor(0, 0, 0);
			}
		}
		fIcon.SetBits(bits.data(), bits.size(), 0, B_CMAP8);
	}

	void AttachedToWindow() override { MakeFocus(true); }

	void Draw(BRect) override
	{
		SetHighColor(0, 0, 0);
		FillRect(BRect(10, 10, 19, 19));
		StrokeRect(BRect(30, 10, 49, 29));
		SetPenSize(2);
		StrokeLine(BPoint(32, 20), BPoint(47, 20));
		StrokeLine(BPoint(39, 12), BPoint(39, 27));
		SetPenSize(1);
		StrokeLine(BPoint(60, 10), BPoint(90, 29));

		SetDrawingMode(B_OP_OVER);
		DrawBitmap(&fIcon, BPoint(100, 10));
		BFont font(be_plain_font);
		font.SetSize(10);
		SetFont(&font);
		MovePenTo(10, 50);
		SetHighColor(0, 0, 255);
		DrawString("B");
		SetHighColor(255, 0, 0);
		DrawString("e");
		SetHighColor(0, 0, 0);
		DrawString("Varnel  \xc3\xa9t\xc3\xa9 ( empty )");
		BFont bold(be_bold_font);
		bold.SetSize(13);
		SetFont(&bold);
		DrawString("Contents of", BPoint(10, 75));

		SetDrawingMode(B_OP_COPY);
		SetLowColor(150, 150, 150);
		FillRect(BRect(0, 90, 319, 105), B_SOLID_LOW);
		SetLowColor(205, 205, 205);
		SetDrawingMode(B_OP_MAX);
		SetHighColor(150, 150, 150);
		FillRect(BRect(90, 40, 300, 80));
		SetDrawingMode(B_OP_COPY);

		if (fMarked) {
			SetHighColor(255, 0, 0);
			FillRect(BRect(280, 150, 299, 169));
		}
		if (fClicked) {
			SetHighColor(0, 0, fClicks == 2 ? 255 : 0);
			FillRect(BRect(fClick.x - 2, fClick.y - 2, fClick.x + 2, fClick.y + 2));
		}
	}

	void KeyDown(const char* bytes, int32) override
	{
		int32 key = Window()->CurrentMessage()->GetInt32("key", 0);
		if (bytes[0] == B_FUNCTION_KEY && key == B_F5_KEY) {
			fMarked = true;
			Invalidate();
		} else if (bytes[0] == B_ESCAPE && key == 1)
			be_app->PostMessage(B_QUIT_REQUESTED);
	}

	void MouseDown(BPoint where) override
	{
		fClicked = true;
		fClick = where;
		fClicks = Window()->CurrentMessage()->GetInt32("clicks", 0);
		Invalidate();
	}

private:
	BBitmap fIcon;
	bool fMarked = false;
	bool fClicked = false;
	BPoint fClick;
	int32 fClicks = 0;
};

bool Dump(const BWindow* window, const char* path)
{
	std::vector<uint32> pixels;
	int32 width;
	int32 height;
	if (!BPrivate::Headless::WaitForIdle()
		|| BPrivate::Headless::ReadPixels(window, &pixels, &width, &height) != B_OK)
		return false;
	FILE* file = fopen(path, "wb");
	if (file == nullptr)
		return false;
	for (uint32 pixel : pixels) {
		const uint8 rgb[3] = {uint8(pixel >> 16), uint8(pixel >> 8), uint8(pixel)};
		fwrite(rgb, 1, 3, file);
	}
	return fclose(file) == 0;
}

}

int main(int argc, char** argv)
{
	BApplication application("application/x-vnd.Varnel-interface-demo");
	BWindow* window = new BWindow(kFrame, "Interface demo", B_TITLED_WINDOW_LOOK,
		B_NORMAL_WINDOW_FEEL, B_NOT_RESIZABLE);
	window->AddChild(new DemoView);
	window->Show();
	if (argc == 3 && strcmp(argv[1], "--dump") == 0) {
		bool dumped = Dump(window, argv[2]);
		window->Lock();
		window->Quit();
		return dumped ? 0 : 1;
	}
	application.Run();
	return 0;
}
