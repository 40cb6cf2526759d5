// Keeps libraries loaded until the end, so that the leak checker can name those whose memory lives that long.
extern "C" int dlclose(void*)
{
    return 0;
}
