#ifndef HOST_ENUMVALUE_H
#define HOST_ENUMVALUE_H

namespace IC
{

/**
 * One value of an enumeration whose meaning belongs to the property that carries it.
 *
 * Contract: the plug-in makes room for objects of this class itself, so their size is fixed; see
 * OpenMI.h.
 */
class EnumValue
{
public:
    explicit EnumValue(unsigned int const& value);
    explicit EnumValue(unsigned short const& value);
    EnumValue(EnumValue const& other);
    EnumValue& operator=(EnumValue const& other);
    ~EnumValue();

    /** What a host reads; management interfaces do not call it. */
    unsigned int getValue() const;

private:
    unsigned int value_;
};

} // namespace IC

#endif
