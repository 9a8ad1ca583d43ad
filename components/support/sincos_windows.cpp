// MinGW's own sine and cosine leave the argument to the processor, which takes pi for a number of 66 bits: near
// its multiples most digits are wrong. These are the system's, which other libraries agree with.

extern "C" {

extern double (*__imp_sin)(double);
extern double (*__imp_cos)(double);

double sin(double x) { return __imp_sin(x); }
double cos(double x) { return __imp_cos(x); }

void sincos(double x, double* sine, double* cosine) {
    *sine = __imp_sin(x);
    *cosine = __imp_cos(x);
}
}
