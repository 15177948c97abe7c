// A plug-in that needs a function of its host which no host of this contract has.

extern "C" int hostOperationFromTheFuture();

extern "C" int OpenMI(void**, void**)
{
    return hostOperationFromTheFuture();
}
