/* A library that loads but serves nothing. */
extern const int nothing_served;
const int nothing_served = 0;
