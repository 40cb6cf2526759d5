// Keeps libraries loaded until the end, so that the leak checker can name the owners of memory that lives
// that long.
extern "C" int dlclose(void*)
{
    return 0;
}
