#include "routine_call.h"

#if defined(__i386__)
#include <cstdio>
#include <cstdlib>

// The call aligns the stack to 16 bytes at the call as the i386 ABI wants,
// keeps the stack pointer of before the pushes in EDI (preserved by every
// x86 convention) and compares it with the one the routine returns with.
asm(R"(
    .text
    .p2align 4
    .globl StandinStdcallCall
    .hidden StandinStdcallCall
    .type StandinStdcallCall, @function
StandinStdcallCall:
    .cfi_startproc
    pushl %ebp
    .cfi_def_cfa_offset 8
    .cfi_offset %ebp, -8
    movl %esp, %ebp
    .cfi_def_cfa_register %ebp
    pushl %esi
    pushl %edi
    .cfi_offset %esi, -12
    .cfi_offset %edi, -16
    movl 12(%ebp), %esi
    movl 16(%ebp), %ecx
    leal 0(,%ecx,4), %eax
    movl %esp, %edi
    subl %eax, %edi
    andl $-16, %edi
    addl %eax, %edi
    movl %edi, %esp
1:  testl %ecx, %ecx
    jz 2f
    pushl -4(%esi,%ecx,4)
    decl %ecx
    jmp 1b
2:  call *8(%ebp)
    movl %edi, %ecx
    subl %esp, %ecx
    movl 20(%ebp), %edx
    movl %ecx, (%edx)
    leal -8(%ebp), %esp
    popl %edi
    popl %esi
    popl %ebp
    .cfi_def_cfa %esp, 4
    ret
    .cfi_endproc
    .size StandinStdcallCall, .-StandinStdcallCall
)");

namespace standin {

void ReportUnbalancedCall(int32_t unpopped, uint32_t count) {
  std::fprintf(stderr,
               "a routine of the library was called with %u argument words and left %d bytes on the "
               "stack: routine-table entries must be __stdcall (TVCALL) and take %u arguments\n",
               count, unpopped, count);
  std::abort();
}

}  // namespace standin
#endif
