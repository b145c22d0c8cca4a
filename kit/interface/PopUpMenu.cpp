#include <PopUpMenu.h>

#include <Looper.h>
#include <Window.h>

#include "MenuPrivate.h"

namespace BPrivate {

struct PopUpMenuData {
	bool autoDestruct = false;
	std::shared_ptr<MenuSession> session;
};

}

BPopUpMenu::BPopUpMenu(const char* name, bool radioMode, bool labelFromMarked,
	menu_layout layout)
	:
	BMenu(name, layout),
	fPopUpMenuData(std::make_unique<BPrivate::PopUpMenuData>())
{
	SetRadioMode(radioMode);
	SetLabelFromMarked(labelFromMarked);
}

BPopUpMenu::~BPopUpMenu()
{
	if (fPopUpMenuData->session != nullptr)
		fPopUpMenuData->session->Close();
}

BMenuItem* BPopUpMenu::Go(BPoint screenPoint, bool deliversMessage, bool openAnyway,
	bool asynchronous)
{
	return _Go(screenPoint, deliversMessage, openAnyway, nullptr, asynchronous);
}

BMenuItem* BPopUpMenu::Go(BPoint screenPoint, bool deliversMessage, bool openAnyway,
	BRect clickToOpen, bool asynchronous)
{
	return _Go(screenPoint, deliversMessage, openAnyway, &clickToOpen, asynchronous);
}

void BPopUpMenu::SetAsyncAutoDestruct(bool state)
{
	fPopUpMenuData->autoDestruct = state;
}

bool BPopUpMenu::AsyncAutoDestruct() const
{
	return fPopUpMenuData->autoDestruct;
}

BMenuItem* BPopUpMenu::_Go(BPoint screenPoint, bool deliversMessage, bool openAnyway,
	const BRect* clickToOpen, bool asynchronous)
{
	BPrivate::PopUpMenuData& data = *fPopUpMenuData;
	// Still open from an asynchronous Go.
	if (data.session != nullptr && data.session->IsOpen())
		return nullptr;
	BLooper* looper = BLooper::LooperForThread(find_thread(NULL));
	if (looper != nullptr)
		BPrivate::MenuAccess::Install(this, looper);

	BPrivate::MenuSession::Options options;
	options.deliversMessage = deliversMessage;
	options.openAnyway = openAnyway;
	options.hasClickRect = clickToOpen != nullptr;
	if (clickToOpen != nullptr)
		options.clickRect = *clickToOpen;
	options.waited = !asynchronous;
	options.autoDelete = asynchronous && data.autoDestruct;
	data.session = BPrivate::MenuSession::StartPopUp(this, screenPoint, options);
	if (asynchronous)
		return nullptr;

	BMenuItem* chosen = data.session->Wait();
	data.session.reset();
	if (BWindow* window = dynamic_cast<BWindow*>(looper))
		BPrivate::ForgetPress(window);
	return chosen;
}
