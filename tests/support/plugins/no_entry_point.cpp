// A library that is not a plug-in: it lacks OpenMI.

extern "C" int OpenSomethingElse()
{
    return 0;
}
