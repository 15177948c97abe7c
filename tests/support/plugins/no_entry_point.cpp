// A library that is no plug-in: it lacks OpenMI.

extern "C" int OpenSomethingElse()
{
    return 0;
}
