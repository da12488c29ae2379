// A shape in the camera grid's 2D view, turned about a point. The view is a scale and then an offset.
uniform vec4 u_View2D;
// In radians.
uniform float u_Rotation;
uniform vec2 u_RotationCentre;

attribute vec2 a_position;

void main()
{
	float s = sin(u_Rotation);
	float c = cos(u_Rotation);
	vec2 offset = a_position - u_RotationCentre;
	vec2 position = u_RotationCentre + vec2(c * offset.x - s * offset.y, s * offset.x + c * offset.y);
	gl_Position = vec4(position * u_View2D.xy + u_View2D.zw, 0.0, 1.0);
}
