#include "AppVarnel.h"

int main()
{
	AppVarnel* app = new AppVarnel;
	app->Run();
	delete app;
	return 0;
}
