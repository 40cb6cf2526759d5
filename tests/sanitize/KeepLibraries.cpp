// Keeps libraries loaded until the end, so that the leak checker can name the owners of memory that lives
// that long. The system calls it only if it is visible.
extern "C" [[gnu::visibility("default")]] int dlclose(void*)
{
    return 0;
}
