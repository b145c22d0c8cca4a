#include <Application.h>

int main()
{
	BApplication app("application/x-vnd.Quillmoor.Varnel-2");
	app.PostMessage(B_QUIT_REQUESTED);
	app.Run();
	return 0;
}
