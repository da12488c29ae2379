/// Asked by the leak checker at the program's end: Qt's offscreen platform loses its screen there, and the checker dies
/// of a driver's variables (DriversUnderSanitizers.cpp).
extern "C" int __lsan_is_turned_off()
{
	return 1;
}
