// A square that faces the eye, of a size in pixels, about a place in the world.
uniform mat4 u_ViewProjection;
uniform vec2 u_ViewportSize;
// Place, and size.
uniform vec4 u_ReconPosAndSize;

attribute vec2 a_position;

varying vec2 v_UV;

void main()
{
	v_UV = a_position;
	gl_Position = u_ViewProjection * vec4(u_ReconPosAndSize.xyz, 1.0);
	gl_Position.xy += 2.0 * u_ReconPosAndSize.w * (a_position - 0.5) / u_ViewportSize * gl_Position.w;
}
