#ifndef TESTS_HOSTCHECK_OTHER_HOST_BROKEN_H
#define TESTS_HOSTCHECK_OTHER_HOST_BROKEN_H

/** The ways in which this host can be broken; BROKEN names one when a file is compiled. */
enum class Way {
    Nothing,
    BooleanIsANumber,
    ShortEnumIsAByte,
    ErrorCopyLosesText,
    FlagIsForgotten,
    DatesAreUtc,
    NumberIsThePrefix,
    LockExcludesNobody,
    LockIgnoresTheTime,
    UnlockReturnsOne,
    StrayBytesAreReplaced,
    NullTextIsRead,
    ExtraIsRead,
    NumbersOvertakeText,
    UnsetClearsTheValue,
    FirstValueStays,
    BaseCallsDerived,
    IdIsNotTakenAway,
    ListsTwice,
    CallsBackTwice,
    AnswerIsDropped,
    NodeIsNotDeleted,
    UnlistedIsDeleted,
    UnloadKeepsNodes,
    CountsFromItsOwnId
};

#ifndef BROKEN
#define BROKEN Nothing
#endif

// Static: the files of one host are compiled with different values of BROKEN.
static constexpr bool broken(Way way)
{
    return way == Way::BROKEN;
}

#endif
