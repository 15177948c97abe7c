// A kernel module with only what modinfo reads.

asm(".section .modinfo, \"a\"\n"
    ".asciz \"description=A disk of memory\"\n"
    ".asciz \"version=1.4.2\"\n"
    ".asciz \"srcversion=0D3AAC3E6C2A4A0A0F0E9F1\"\n"
    ".asciz \"license=GPL\"\n"
    ".asciz \"depends=\"\n"
    ".asciz \"vermagic=6.1.0 SMP mod_unload modversions \"\n"
    ".previous\n");
