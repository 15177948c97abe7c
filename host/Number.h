#ifndef HOST_NUMBER_H
#define HOST_NUMBER_H

namespace IC
{

/**
 * An unsigned number, a truth value or a point in time.
 *
 * A value type: copies are independent, and reading one from several threads is safe.
 *
 * Contract: the plug-in makes room for objects of this class itself, so their size is fixed; see
 * OpenMI.h.
 */
class Number
{
public:
    enum KindType { EmptyKind = 0, UnsignedKind = 1, BooleanKind = 2, DateKind = 3 };

    explicit Number(unsigned int const& value);
    explicit Number(bool const& value);

    /**
     * A point in time.
     *
     * @param seconds     since 1970-01-01 00:00 UTC; may be negative
     * @param subSeconds  kept for the host; a management interface passes 0
     */
    Number(long seconds, unsigned short subSeconds);

    /** A number of the given kind that holds no value; it reads as 0. */
    explicit Number(KindType const& kind);

    Number(Number const& other);
    Number& operator=(Number const& other);
    ~Number();

    // What a host reads; management interfaces do not call these.

    KindType getKind() const;

    /** The number, 0 or 1 for a truth value, seconds since 1970 for a point in time. */
    long long getValue() const;

    /** The subSeconds of a point in time; 0 for other kinds. */
    unsigned short getSubSeconds() const;

private:
    KindType kind_;
    unsigned short subSeconds_;
    long long value_;
};

} // namespace IC

#endif
