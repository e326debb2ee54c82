/* Prints a variable of each component. */
#include <stdio.h>

#include "plant_Left.h"
#include "plant_Right.h"

int main(void) {
  printf("%d %d\n", Gain, Gain_a);
  return 0;
}
