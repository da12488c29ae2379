// A square of a camera's mask, in pixels of the sensor.
uniform vec4 u_View2D;
// Least corner, and size.
uniform vec4 u_Square;

attribute vec2 a_position;

varying vec2 v_UV;

void main()
{
	v_UV = a_position;
	gl_Position = vec4((u_Square.xy + u_Square.zw * a_position) * u_View2D.xy + u_View2D.zw, 0.0, 1.0);
}
