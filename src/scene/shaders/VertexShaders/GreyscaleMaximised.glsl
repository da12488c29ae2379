// A patch of a camera's picture, spread about its middle.
uniform vec4 u_View2D;
// Least corner, and size.
uniform vec4 u_Patch;
uniform float u_Factor;

attribute vec2 a_position;

varying vec2 v_UV;

void main()
{
	v_UV = a_position;
	gl_Position = vec4((u_Patch.xy + u_Patch.zw * ((a_position - 0.5) * u_Factor + 0.5)) * u_View2D.xy + u_View2D.zw, 0.0, 1.0);
}
