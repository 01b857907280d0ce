#include <VelaMediaLib/base/TransformMatrix.h>

#include <cmath>

namespace VelaMediaLib {

TransformMatrix::TransformMatrix() : m_{} {
    for (int i = 0; i < 4; ++i) m_[i * 5] = 1.0;
}

TransformMatrix TransformMatrix::translation(double x, double y, double z) {
    TransformMatrix t;
    t.set(0, 3, x);
    t.set(1, 3, y);
    t.set(2, 3, z);
    return t;
}

TransformMatrix TransformMatrix::scaling(double x, double y, double z) {
    TransformMatrix t;
    t.set(0, 0, x);
    t.set(1, 1, y);
    t.set(2, 2, z);
    return t;
}

// The rotation in the plane of axes a and b (a turning towards b).
static TransformMatrix planeRotation(int a, int b, double radians) {
    TransformMatrix t;
    const double c = std::cos(radians), s = std::sin(radians);
    t.set(a, a, c);
    t.set(a, b, -s);
    t.set(b, a, s);
    t.set(b, b, c);
    return t;
}

TransformMatrix TransformMatrix::rotationX(double radians) { return planeRotation(1, 2, radians); }
TransformMatrix TransformMatrix::rotationY(double radians) { return planeRotation(2, 0, radians); }
TransformMatrix TransformMatrix::rotationZ(double radians) { return planeRotation(0, 1, radians); }

TransformMatrix TransformMatrix::shearing(double xByY, double yByX) {
    TransformMatrix t;
    t.set(0, 1, xByY);
    t.set(1, 0, yByX);
    return t;
}

TransformMatrix TransformMatrix::operator*(const TransformMatrix& other) const {
    TransformMatrix product;
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 4; ++column) {
            double sum = 0.0;
            for (int k = 0; k < 4; ++k) sum += at(row, k) * other.at(k, column);
            product.set(row, column, sum);
        }
    return product;
}

Point3d TransformMatrix::apply(const Point3d& p) const {
    return Point3d(at(0, 0) * p.x + at(0, 1) * p.y + at(0, 2) * p.z + at(0, 3),
                   at(1, 0) * p.x + at(1, 1) * p.y + at(1, 2) * p.z + at(1, 3),
                   at(2, 0) * p.x + at(2, 1) * p.y + at(2, 2) * p.z + at(2, 3));
}

std::ostream& operator<<(std::ostream& out, const TransformMatrix& matrix) {
    out << "TransformMatrix(";
    for (int i = 0; i < 16; ++i) out << (i ? ", " : "") << matrix.elements()[i];
    return out << ")";
}

} // namespace VelaMediaLib
