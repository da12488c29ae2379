// A line in the colours of its ends, in world space; how far along it a pixel is counts in pixels.
uniform mat4 u_ViewProjection;
uniform vec2 u_ViewportSize;

attribute vec3 a_position;
attribute vec4 a_colour;

varying vec4 v_Colour;
varying vec2 v_Screen;

void main()
{
	v_Colour = a_colour;
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
	v_Screen = 0.5 * u_ViewportSize * gl_Position.xy / max(gl_Position.w, 1e-6);
}
